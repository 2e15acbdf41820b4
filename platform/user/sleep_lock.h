// The lock by which a program that starts savers keeps the machine awake until the saver is up.
#pragma once

namespace seam {

/// Takes over the descriptor that XSS_SLEEP_LOCK_FD names, and the variable out of the environment.
/// To be called before this process opens anything itself: a number that isn't an open pipe now
/// could be that of another file later.
void takeSleepLock();

bool sleepLockIsHeld();

/// Lets the machine sleep; does nothing if there is no lock.
void releaseSleepLock();

} // namespace seam

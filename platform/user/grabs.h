// The windows in front of all others (a saver's, a box over it), and the keyboard and the pointer
// that are kept for them while a password guards the screen.
#pragma once

#include <vector>

class QWindow;

namespace seam {

/// From now on the window that stands in front of all others has keyboard and pointer to itself,
/// or no longer. Another program may hold them for a moment, as an open menu does: it is tried
/// again until it succeeds. On a platform of the toolkit other than X11 it can't be done.
void holdInput(bool hold);

bool inputIsHeld();

/// The window stands in front from now on: it takes what is held from the one before, which gets
/// it back with giveBack, or when this one is destroyed. Before the window is hidden, so that
/// nobody else gets it in between.
void bringForward(QWindow& window);
void giveBack(const QWindow& window);

/// These windows, the one in front last.
const std::vector<QWindow*>& windowsInFront();

} // namespace seam

// How a command that makes files is ended from outside: it stops where it can, takes away what is
// half made, and then ends as the signal would have ended it.
#pragma once

/// From now on SIGINT, SIGTERM and SIGHUP are kept for Interruption, but for one that was ignored
/// when the process started. One that comes more than a second after the first ends the process at
/// once: something hangs then. A file that grows beyond what the user may write is an error like
/// that of a full disk, and ends nothing.
void CatchInterruptions();

/// The signal that has come; 0 if none has.
int Interruption();

/// Ends the process as the signal does that nobody catches. Gives 1 if that doesn't end it.
int EndBySignal(int signal);

// How the program ends from outside: by a signal, or because the display goes.
#pragma once

namespace seam {

/// From now on SIGTERM, SIGINT and SIGHUP send WM_ENDSESSION to every top-level window, which
/// destroys it, and ask the innermost loop to end; boxes are cancelled. One that was ignored when
/// the process started (as SIGHUP is under nohup) stays ignored, and one that the process has seen
/// to itself is left to it; SIGPIPE is ignored from now on.
void catchSignals();

/// Sees to it that windows which still stand when the process exits get WM_DESTROY: the toolkit
/// exits on its own when the connection to the display breaks. Called where a loop begins, when
/// all that handlers need is there, so that it outlives them.
void endWindowsAtExit();

} // namespace seam

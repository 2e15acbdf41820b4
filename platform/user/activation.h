// Windows that are about to get the keyboard.
#pragma once

class QWindow;

namespace seam {

/// Asks for the keyboard for a window, and again if that doesn't bring it. The X server and the
/// window manager give it a moment later, if they do; for as long, and two seconds at most, it is
/// on its way.
void activate(QWindow& window);
bool keyboardIsOnItsWay();

/// For a key while no window of ours has the keyboard: true for two seconds from the first one on,
/// or until a window has it.
bool keyboardMayReturn();

} // namespace seam

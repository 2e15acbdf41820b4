// Windows that are about to get the keyboard.
#pragma once

class QWindow;

namespace seam {

/// Asks for the keyboard for a window. The X server and the window manager give it a moment later,
/// if they do; for as long, and two seconds at most, it is on its way.
void activate(QWindow& window);
bool keyboardIsOnItsWay();

} // namespace seam

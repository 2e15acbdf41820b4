// The toolkit's application object, made when the first window, screen or text needs it.
#pragma once

#include <QPoint>

#include <cstdint>

struct xcb_connection_t;

namespace seam {

/// Makes the application object if there is none yet. False if there is no display to show
/// anything on; said once on the standard error output.
bool toolkit();

/// The connection to the X server; null on any other platform of the toolkit.
xcb_connection_t* xConnection();

/// The window that all others on the display lie in.
std::uint32_t rootWindow(xcb_connection_t* connection);

/// Where positions on the screen count from: the primary monitor's corner as it was when first
/// asked for. It stays, so that a monitor that comes or goes isn't taken for a move of the mouse.
QPoint screenOrigin();

} // namespace seam

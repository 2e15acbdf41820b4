// Keys and buttons of the toolkit as the messages and codes of the platform.
#pragma once

#include "platform/user.h"

#include <QPoint>
#include <Qt>

class QKeyEvent;
class QMouseEvent;
class QWheelEvent;

namespace seam {

/// Queues WM_KEYDOWN, WM_KEYUP or their WM_SYS... form (Alt held, or F10) for the window.
void queueKey(HWND window, const QKeyEvent& event, bool down);

/// Queues a mouse message for the window, whose client area begins at `corner` of what the event
/// counts from.
void queueMouse(HWND window, UINT message, const QMouseEvent& event, QPoint corner = {});
void queueWheel(HWND window, const QWheelEvent& event);

/// The message of a button going down or up; the middle button's for any further button.
UINT buttonMessage(Qt::MouseButton button, bool down);

} // namespace seam

// Keys and buttons of the toolkit as the messages and codes of the platform.
#pragma once

#include "platform/user.h"

#include <Qt>

class QKeyEvent;

namespace seam {

/// Queues WM_KEYDOWN, WM_KEYUP or their WM_SYS... form (Alt held, or F10) for the window.
void queueKey(HWND window, const QKeyEvent& event, bool down);

/// The message of a button going down or up; the middle button's for any further button.
UINT buttonMessage(Qt::MouseButton button, bool down);

/// The wParam of mouse messages: which buttons are down (1 left, 2 right, 16 middle).
WPARAM buttonsOf(Qt::MouseButtons buttons);

} // namespace seam

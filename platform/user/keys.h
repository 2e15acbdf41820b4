// Keys and buttons of the toolkit as the messages and codes of the platform.
#pragma once

#include "platform/user.h"

#include <QPoint>
#include <Qt>

class QKeyEvent;
class QMouseEvent;
class QWheelEvent;

namespace seam {

// Of the keys that are held with another one.
constexpr UINT shiftHeld = 1;
constexpr UINT ctrlHeld = 2;
constexpr UINT altHeld = 4;
constexpr UINT metaHeld = 8;

struct KeyStroke {
    WPARAM code = 0; // the platform's
    UINT held = 0;

    friend bool operator==(const KeyStroke&, const KeyStroke&) = default;
};

/// Which key is pressed and what is held with it. Digits of the keypad have codes of their own.
KeyStroke keyStroke(const QKeyEvent& event);

/// The same of a message that queueKey has queued.
KeyStroke keyStroke(const MSG& message);

/// Queues WM_KEYDOWN, WM_KEYUP or their WM_SYS... form (Alt held, or F10) for the window. What is
/// held with the key stands in the bits of lParam from 32 up.
void queueKey(HWND window, const QKeyEvent& event, bool down);

/// Queues a mouse message for the window, whose client area begins at `corner` of what the event
/// counts from.
void queueMouse(HWND window, UINT message, const QMouseEvent& event, QPoint corner = {});
void queueWheel(HWND window, const QWheelEvent& event);

/// The message of a button going down or up; the middle button's for any further button.
UINT buttonMessage(Qt::MouseButton button, bool down);

} // namespace seam

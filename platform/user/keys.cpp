#include "platform/user/keys.h"

#include "platform/user/queue.h"
#include "platform/user/toolkit.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QWheelEvent>
#include <QtMath>

#include <algorithm>
#include <array>
#include <string_view>

namespace seam {

namespace {

struct KeyCode {
    int key;
    WPARAM code;
};

/// The platform's codes of the keys that have no character. Letters, digits and the blank have
/// that of their capital.
constexpr std::array<KeyCode, 31> keyCodes{{
    {Qt::Key_Backspace, 0x08}, {Qt::Key_Tab, 0x09},      {Qt::Key_Backtab, 0x09},
    {Qt::Key_Return, 0x0D},    {Qt::Key_Enter, 0x0D},    {Qt::Key_Shift, 0x10},
    {Qt::Key_Control, 0x11},   {Qt::Key_Alt, 0x12},      {Qt::Key_Pause, 0x13},
    {Qt::Key_CapsLock, 0x14},  {Qt::Key_Escape, 0x1B},   {Qt::Key_PageUp, 0x21},
    {Qt::Key_PageDown, 0x22},  {Qt::Key_End, 0x23},      {Qt::Key_Home, 0x24},
    {Qt::Key_Left, 0x25},      {Qt::Key_Up, 0x26},       {Qt::Key_Right, 0x27},
    {Qt::Key_Down, 0x28},      {Qt::Key_Print, 0x2C},    {Qt::Key_Insert, 0x2D},
    {Qt::Key_Delete, 0x2E},    {Qt::Key_Help, 0x2F},     {Qt::Key_Meta, 0x5B},
    {Qt::Key_Menu, 0x5D},      {Qt::Key_Asterisk, 0x6A}, {Qt::Key_Plus, 0xBB},
    {Qt::Key_Minus, 0xBD},     {Qt::Key_NumLock, 0x90},  {Qt::Key_ScrollLock, 0x91},
    {Qt::Key_AltGr, 0x12},
}};

/// Where no code goes by the character (an alphabet without A to Z, digits that need Shift), it
/// goes by the place of the key: as on an American keyboard. X counts keys from 8 on.
WPARAM codeOfPlace(quint32 scanCode) {
    struct Row {
        quint32 first;
        std::string_view keys;
    };

    constexpr Row rows[] = {
        {10, "1234567890"}, {24, "QWERTYUIOP"}, {38, "ASDFGHJKL"}, {52, "ZXCVBNM"}};
    for (const Row& row : rows) {
        if (scanCode >= row.first && scanCode < row.first + row.keys.size()) {
            return static_cast<WPARAM>(row.keys[scanCode - row.first]);
        }
    }
    return 0xFF; // a key without a code
}

WPARAM codeOf(const QKeyEvent& event) {
    const int key = event.key();
    constexpr WPARAM keypadZero = 0x60;
    if ((event.modifiers() & Qt::KeypadModifier) != 0 && key >= Qt::Key_0 && key <= Qt::Key_9) {
        return keypadZero + static_cast<WPARAM>(key - Qt::Key_0); // these have codes of their own
    }
    if ((key >= Qt::Key_A && key <= Qt::Key_Z) || (key >= Qt::Key_0 && key <= Qt::Key_9) ||
        key == Qt::Key_Space) {
        return static_cast<WPARAM>(key);
    }
    if (key >= Qt::Key_F1 && key <= Qt::Key_F24) {
        return static_cast<WPARAM>(0x70 + key - Qt::Key_F1);
    }
    const auto* found = std::find_if(keyCodes.begin(), keyCodes.end(),
                                     [key](const KeyCode& entry) { return entry.key == key; });
    return found == keyCodes.end() ? codeOfPlace(event.nativeScanCode()) : found->code;
}

/// The wParam of mouse messages: which buttons are down.
WPARAM buttonsOf(Qt::MouseButtons buttons) {
    return ((buttons & Qt::LeftButton) != 0 ? 1U : 0U) |
           ((buttons & Qt::RightButton) != 0 ? 2U : 0U) |
           ((buttons & Qt::MiddleButton) != 0 ? 16U : 0U);
}

constexpr int heldShift = 32; // where lParam has what is held with a key

UINT heldOf(Qt::KeyboardModifiers modifiers) {
    return ((modifiers & Qt::ShiftModifier) != 0 ? shiftHeld : 0U) |
           ((modifiers & Qt::ControlModifier) != 0 ? ctrlHeld : 0U) |
           ((modifiers & Qt::AltModifier) != 0 ? altHeld : 0U) |
           ((modifiers & Qt::MetaModifier) != 0 ? metaHeld : 0U);
}

} // namespace

KeyStroke keyStroke(const QKeyEvent& event) {
    return {codeOf(event), heldOf(event.modifiers())};
}

KeyStroke keyStroke(const MSG& message) {
    return {message.wParam, static_cast<UINT>(message.lParam >> heldShift)};
}

void queueKey(HWND window, const QKeyEvent& event, bool down) {
    const bool system = event.key() == Qt::Key_F10 || event.key() == Qt::Key_Alt ||
                        (event.modifiers() & Qt::AltModifier) != 0;
    const UINT message =
        down ? (system ? WM_SYSKEYDOWN : WM_KEYDOWN) : (system ? WM_SYSKEYUP : WM_KEYUP);
    const LPARAM repeated = event.isAutoRepeat() ? LPARAM{1} << 30 : 0;
    const auto [code, held] = keyStroke(event);
    queueInput({window, message, code, (LPARAM{held} << heldShift) | repeated | 1, 0});
}

void queueMouse(HWND window, UINT message, const QMouseEvent& event, QPoint corner) {
    const QPointF in = event.position(); // a pixel's right half belongs to it
    const QPoint at = QPoint(qFloor(in.x()), qFloor(in.y())) - corner;
    queueInput({window, message, buttonsOf(event.buttons()),
                static_cast<LPARAM>(MAKELONG(at.x(), at.y())), 0});
}

void queueWheel(HWND window, const QWheelEvent& event) {
    const QPoint at = event.globalPosition().toPoint() - screenOrigin();
    queueInput({window, WM_MOUSEWHEEL, static_cast<WPARAM>(MAKELONG(0, event.angleDelta().y())),
                static_cast<LPARAM>(MAKELONG(at.x(), at.y())), 0});
}

UINT buttonMessage(Qt::MouseButton button, bool down) {
    switch (button) {
    case Qt::LeftButton:
        return down ? WM_LBUTTONDOWN : WM_LBUTTONUP;
    case Qt::RightButton:
        return down ? WM_RBUTTONDOWN : WM_RBUTTONUP;
    default:
        return down ? WM_MBUTTONDOWN : WM_MBUTTONUP;
    }
}

} // namespace seam

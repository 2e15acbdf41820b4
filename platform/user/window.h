// The record behind a window's handle.
#pragma once

#include "platform/handle_table.h"
#include "platform/user.h"
#include "platform/user/input_contexts.h"

#include <QPoint>

#include <functional>
#include <memory>
#include <string>

class QEvent;
class QWidget;
class QWindow;

namespace seam {

class Control;
class DialogWindow;
class FrameWindow;
class NativeWindow;
class WindowPicture;

struct WindowClass {
    std::string name;
    UINT style = 0;
    WNDPROC procedure = nullptr;
    HINSTANCE instance;
    HICON icon;
    HCURSOR cursor;
    HBRUSH background;
};

struct Window {
    HWND handle;
    WindowClass* windowClass = nullptr;
    HINSTANCE instance;
    HWND parent; // of a child; may be another program's window
    HWND owner;  // with which a top-level window goes
    int id = 0;  // of a control
    DWORD style = 0;
    bool topmost = false;
    std::string title;
    RECT place{0, 0, 0, 0}; // in the parent's client area, or on the screen
    int border = 0;         // on each side, around its client area
    bool visible = false;
    bool dying = false; // WM_DESTROY has been sent
    bool paintNeeded = false;
    bool painted = false; // has been asked to, and has begun
    bool eraseNeeded = false;
    HMENU menu; // its menu bar
    HIMC inputContext = defaultInputContext;
    RECT update{0, 0, 0, 0}; // bounds of what WM_PAINT has to paint
    bool enabled = true;
    // One of the four stands behind it.
    std::unique_ptr<NativeWindow> native;
    std::unique_ptr<FrameWindow> frame;
    std::unique_ptr<DialogWindow> dialog;
    std::unique_ptr<Control> control;

    Window();
    ~Window();

    /// Of its client area.
    int width() const {
        return place.right - place.left - 2 * border;
    }

    int height() const {
        return place.bottom - place.top - 2 * border;
    }

    /// What the program draws on; null for a dialog or a control.
    WindowPicture* picture() const;
};

/// The record of a window of this program; null for any other number.
Window* findWindow(HWND window);

/// Takes a window in and gives its handle, which is written into it; null if there are too many.
HWND addWindow(std::unique_ptr<Window> window);

/// The toolkit's window that it is, or lies in; null while there is none.
QWindow* toolkitWindow(const Window& window);

/// The widget of a framed window, a dialog or a control.
QWidget& widgetOf(const Window& window);

/// Whether the event is input to a window that EnableWindow has shut, or to one in such a window.
/// It is then dealt with.
bool inputIsBarred(HWND window, QEvent& event);

/// Whether EnableWindow has shut the window, or one that it lies in.
bool isDisabled(HWND window);

/// Shows a window that isn't shown yet.
void showWindow(HWND handle);

/// Calls visit for each window of this program, in the order of their slots.
void forEachWindow(const std::function<void(Window&)>& visit);

/// The handle of the window's top-level window.
HWND topLevelOf(HWND window);

/// Which window takes the keys that reach this one: the one that SetFocus named, if both lie in the
/// same top-level window.
HWND keyTarget(HWND window);

/// The window no longer has the keys of its top-level window.
void forgetFocus(HWND window);

/// What its place is counted from: the screen's corner, or that of its parent's client area.
QPoint originOf(const Window& window);

/// Sends WM_SIZE and WM_MOVE with its size and place.
void sendSizeAndPlace(const Window& window);

/// Adds to what has to be painted, in the window and, unless it has WS_CLIPCHILDREN, in windows
/// that lie in it; the area is clipped to the window.
void invalidate(Window& window, RECT area, bool erase);

/// The size of the window's client area has changed: keeps the new size, asks for a full repaint
/// and posts WM_SIZE.
void windowResized(Window& window, int width, int height);

} // namespace seam

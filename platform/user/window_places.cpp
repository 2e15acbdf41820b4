// Where windows stand, whether they show, and which one has the keyboard.
#include "platform/user/window.h"

#include "platform/user/controls/control.h"
#include "platform/user/cursors.h"
#include "platform/user/dialog.h"
#include "platform/user/foreign.h"
#include "platform/user/native_window.h"
#include "platform/user/roster.h"
#include "platform/user/screens.h"
#include "platform/user/toolkit.h"

#include <QEvent>

#include <algorithm>

namespace seam {

namespace {

HWND focus;

/// Whether the window or what it lies in is disabled.
bool isDisabled(HWND window) {
    const Window* found = findWindow(window);
    return found != nullptr && (!found->enabled || isDisabled(found->parent));
}

} // namespace

QWidget& widgetOf(const Window& window) {
    return window.dialog ? static_cast<QWidget&>(*window.dialog) : window.control->widget();
}

QPoint originOf(const Window& window) {
    return window.parent ? QPoint() : screenOrigin();
}

void sendSizeAndPlace(const Window& window) {
    const HWND handle = window.handle;
    SendMessageA(handle, WM_SIZE, 0,
                 static_cast<LPARAM>(MAKELONG(window.width(), window.height())));
    if (const Window* still = findWindow(handle)) {
        SendMessageA(handle, WM_MOVE, 0,
                     static_cast<LPARAM>(MAKELONG(still->place.left, still->place.top)));
    }
}

bool inputIsBarred(HWND window, QEvent& event) {
    if (!isDisabled(window)) {
        return false;
    }
    switch (event.type()) {
    case QEvent::ShortcutOverride:
        event.accept(); // else an underlined letter would be found before its key is pressed
        return true;
    case QEvent::KeyPress:
    case QEvent::KeyRelease:
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
    case QEvent::Wheel:
    case QEvent::Close:
        event.ignore();
        return true;
    default:
        return false;
    }
}

void showWindow(HWND handle) {
    SendMessageA(handle, WM_SHOWWINDOW, TRUE, 0);
    Window* window = findWindow(handle); // its handler may have destroyed it
    if (window == nullptr || window->visible) {
        return;
    }
    window->visible = true;
    if (!window->native) {
        widgetOf(*window).show();
        if (window->dialog) {
            window->dialog->activateWindow();
        }
        return;
    }
    invalidate(*window, {0, 0, window->width(), window->height()}, true);
    applyCursor(*window->native);
    if (fillsScreen(*window)) {
        takeScreens(*window);
    }
    window->native->show();
    if (!window->parent && !window->topmost) {
        window->native->requestActivate(); // without a window manager nobody else sees to that
    }
}

HWND keyTarget(HWND window) {
    return focus && topLevelOf(focus) == topLevelOf(window) ? focus : window;
}

void forgetFocus(HWND window) {
    if (focus == window) {
        focus = {};
    }
}

} // namespace seam

using namespace seam;

BOOL IsIconic(HWND window) {
    const Window* found = findWindow(window);
    const QWindow* native = found != nullptr ? toolkitWindow(*found) : nullptr;
    while (native != nullptr && native->parent() != nullptr) {
        native = native->parent();
    }
    return native != nullptr && (native->windowStates() & Qt::WindowMinimized) != 0 ? TRUE : FALSE;
}

static void hide(Window& window) {
    if (window.native) {
        window.native->hide();
    } else {
        widgetOf(window).hide();
    }
}

BOOL ShowWindow(HWND window, int command) {
    Window* found = findWindow(window);
    if (found == nullptr) {
        return FALSE;
    }
    const bool before = found->visible;
    if (command != SW_HIDE && !before) {
        showWindow(window);
    } else if (command == SW_HIDE && before) {
        found->visible = false;
        hide(*found);
    }
    return before ? TRUE : FALSE;
}

BOOL MoveWindow(HWND window, int x, int y, int width, int height, BOOL repaint) {
    Window* found = findWindow(window);
    if (found == nullptr) {
        return FALSE;
    }
    width = std::max(width, 1);
    height = std::max(height, 1);
    const bool grown = width > found->width() || height > found->height();
    const bool sized = width != found->width() || height != found->height();
    const bool moved = x != found->place.left || y != found->place.top;
    found->place = {x, y, x + width, y + height};
    const QRect place(QPoint(x, y) + originOf(*found), QSize(found->width(), found->height()));
    if (!found->native) {
        widgetOf(*found).setGeometry(place);
        return TRUE;
    }
    if (sized) {
        found->native->resizePicture(place.size());
    }
    found->native->setGeometry(place);
    if (repaint != FALSE || grown) {
        invalidate(*found, {0, 0, found->width(), found->height()}, true);
    }
    if (sized || moved) {
        sendSizeAndPlace(*found);
    }
    return TRUE;
}

BOOL SetWindowPos(HWND window, HWND after, int x, int y, int width, int height, UINT flags) {
    Window* found = findWindow(window);
    if (found == nullptr || after != HWND_TOP) {
        return FALSE;
    }
    if ((flags & SWP_NOZORDER) == 0) {
        toolkitWindow(*found)->raise();
    }
    const RECT place = found->place;
    const bool keepsPlace = (flags & SWP_NOMOVE) != 0;
    const bool keepsSize = (flags & SWP_NOSIZE) != 0;
    return MoveWindow(window, keepsPlace ? place.left : x, keepsPlace ? place.top : y,
                      keepsSize ? found->width() : width, keepsSize ? found->height() : height,
                      FALSE);
}

BOOL GetWindowRect(HWND window, RECT* place) {
    const Window* found = findWindow(window);
    if (found == nullptr) {
        return FALSE;
    }
    *place = found->place;
    if (found->dialog) { // the user may have moved it
        const QRect now = found->dialog->geometry().translated(-screenOrigin());
        *place = {now.left(), now.top(), now.right() + 1, now.bottom() + 1};
        return TRUE;
    }
    for (const Window* outer = findWindow(found->parent); outer != nullptr;
         outer = findWindow(outer->parent)) {
        place->left += outer->place.left;
        place->right += outer->place.left;
        place->top += outer->place.top;
        place->bottom += outer->place.top;
    }
    return TRUE;
}

BOOL GetClientRect(HWND window, RECT* area) {
    if (const Window* found = findWindow(window)) {
        *area = {0, 0, found->width(), found->height()};
        return TRUE;
    }
    SIZE size{};
    if (!foreignSize(window, size)) {
        return FALSE;
    }
    *area = {0, 0, size.cx, size.cy};
    return TRUE;
}

HWND SetFocus(HWND window) {
    const HWND before = focus;
    const Window* found = findWindow(window);
    focus = found != nullptr && found->native ? window : HWND{};
    if (found != nullptr && found->control) {
        found->control->widget().setFocus();
    }
    return before;
}

HWND GetForegroundWindow() {
    HWND result;
    forEachWindow([&](const Window& window) {
        const QWindow* native = toolkitWindow(window);
        if (native != nullptr && native->isActive() && !window.parent) {
            result = window.handle;
        }
    });
    return result ? result : foreignFocus();
}

BOOL SetForegroundWindow(HWND window) {
    if (isRemote(window)) {
        return raiseRemote(window) ? TRUE : FALSE;
    }
    const Window* found = findWindow(window);
    QWindow* native = found != nullptr ? toolkitWindow(*found) : nullptr;
    if (native == nullptr) {
        return FALSE;
    }
    raiseInFront(*native);
    return TRUE;
}

// Where windows stand, whether they show, and which one has the keyboard.
#include "platform/user/window.h"

#include "platform/harness.h"
#include "platform/user/activation.h"
#include "platform/user/controls/control.h"
#include "platform/user/cursors.h"
#include "platform/user/dialog.h"
#include "platform/user/foreign.h"
#include "platform/user/frame_window.h"
#include "platform/user/native_window.h"
#include "platform/user/roster.h"
#include "platform/user/screens.h"
#include "platform/user/toolkit.h"

#include <QApplication>
#include <QEvent>

#include <algorithm>

namespace seam {

namespace {

HWND focus;

} // namespace

bool isDisabled(HWND window) {
    const Window* found = findWindow(window);
    return found != nullptr && (!found->enabled || isDisabled(found->parent));
}

QWidget& widgetOf(const Window& window) {
    if (window.frame) {
        return *window.frame;
    }
    return window.dialog ? static_cast<QWidget&>(*window.dialog) : window.control->widget();
}

QPoint originOf(const Window& window) {
    if (!window.parent) {
        return screenOrigin();
    }
    const Window* parent = findWindow(window.parent);
    return parent != nullptr ? QPoint(parent->border, parent->border) : QPoint();
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
        QWidget& widget = widgetOf(*window);
        invalidate(*window, {0, 0, window->width(), window->height()}, true);
        widget.show();
        if (!window->control) {
            activate(*widget.windowHandle());
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
        activate(*window->native); // without a window manager nobody else sees to that
    }
}

HWND keyTarget(HWND window) {
    return focus && topLevelOf(focus) == topLevelOf(window) ? focus : window;
}

void minimise(HWND window, bool minimised) {
    const Window* found = findWindow(window);
    if (found != nullptr && toolkitWindow(*found) != nullptr) {
        toolkitWindow(*found)->setWindowStates(minimised ? Qt::WindowMinimized : Qt::WindowNoState);
    }
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

/// Only a window manager can bring a window back.
static void minimise(const Window& window) {
    QWindow* native = toolkitWindow(window);
    if (window.visible && !window.parent && native != nullptr && windowsAreManaged()) {
        native->showMinimized();
    }
}

BOOL ShowWindow(HWND window, int command) {
    Window* found = findWindow(window);
    if (found == nullptr) {
        return FALSE;
    }
    const bool before = found->visible;
    if (command == SW_MINIMIZE) {
        minimise(*found);
    } else if (command != SW_HIDE && !before) {
        showWindow(window);
    } else if (command == SW_SHOWNORMAL && IsIconic(window) != FALSE) {
        toolkitWindow(*found)->showNormal();
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
    const int least = 1 + 2 * found->border;
    width = std::max(width, least);
    height = std::max(height, least);
    const RECT before = found->place;
    const int oldWidth = before.right - before.left;
    const int oldHeight = before.bottom - before.top;
    const bool grown = width > oldWidth || height > oldHeight;
    const bool sized = width != oldWidth || height != oldHeight;
    const bool moved = x != found->place.left || y != found->place.top;
    found->place = {x, y, x + width, y + height};
    const QRect place(QPoint(x, y) + originOf(*found), QSize(width, height));
    if (found->picture() == nullptr) {
        widgetOf(*found).setGeometry(place);
        return TRUE;
    }
    if (found->frame) {
        found->frame->moveTo(place);
    } else {
        if (sized) {
            found->native->resizePicture(place.size());
        }
        found->native->setGeometry(place);
    }
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
                      keepsSize ? place.right - place.left : width,
                      keepsSize ? place.bottom - place.top : height, FALSE);
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
        place->left += outer->place.left + outer->border;
        place->right += outer->place.left + outer->border;
        place->top += outer->place.top + outer->border;
        place->bottom += outer->place.top + outer->border;
    }
    return TRUE;
}

BOOL ScreenToClient(HWND window, POINT* point) {
    const Window* found = findWindow(window);
    RECT place{};
    if (found == nullptr || GetWindowRect(window, &place) == FALSE) {
        return FALSE;
    }
    point->x -= place.left + found->border;
    point->y -= place.top + found->border;
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

/// The control that takes the keys; null if none of this program does.
static HWND focusedControl() {
    HWND result;
    const QWidget* widget = QApplication::focusWidget();
    forEachWindow([&](Window& window) {
        result = widget != nullptr && window.control && &window.control->widget() == widget
                     ? window.handle
                     : result;
    });
    return result;
}

HWND SetFocus(HWND window) {
    const HWND control = focusedControl();
    const HWND before = control ? control : focus;
    const Window* found = findWindow(window);
    focus = found != nullptr && found->picture() != nullptr ? window : HWND{};
    if (found != nullptr && found->control) {
        QWidget& widget = found->control->widget();
        if (!widget.isActiveWindow()) {
            activate(*widget.window()->windowHandle());
        }
        widget.setFocus();
    } else if (focus && topLevelOf(control) == topLevelOf(focus)) {
        widgetOf(*findWindow(control)).clearFocus();
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

HWND GetDesktopWindow() {
    return foreignDesktop();
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

// Classes of windows, and making windows of them.
#include "platform/user/window.h"

#include "platform/harness.h"
#include "platform/user/controls/control.h"
#include "platform/user/foreign.h"
#include "platform/user/frame_window.h"
#include "platform/user/icons.h"
#include "platform/user/native_window.h"
#include "platform/user/roster.h"
#include "platform/user/text.h"
#include "platform/user/toolkit.h"

#include <algorithm>
#include <map>
#include <strings.h>

namespace seam {

namespace {

/// Never freed: windows may be destroyed when the process exits.
std::map<std::string, WindowClass>& classes() {
    static auto* const registered = new std::map<std::string, WindowClass>;
    return *registered;
}

QRect placeOnScreen(const Window& window) {
    const RECT& place = window.place;
    return {QPoint(place.left, place.top) + originOf(window),
            QSize(place.right - place.left, place.bottom - place.top)};
}

std::unique_ptr<FrameWindow> makeFrame(const Window& window) {
    auto frame = std::make_unique<FrameWindow>(window.handle, placeOnScreen(window));
    frame->setWindowTitle(shownText(window.title));
    frame->setWindowIcon(iconOf(window.windowClass->icon));
    // What lies over a window that has an owner itself stays in front of it. A window over one that
    // has none is minimised, raised and listed by itself.
    const Window* owner = findWindow(window.owner);
    if (owner != nullptr && owner->owner) {
        frame->windowHandle()->setTransientParent(toolkitWindow(*owner));
    }
    return frame;
}

Qt::WindowFlags flagsOf(const Window& window) {
    Qt::WindowFlags flags = Qt::Window;
    if (!window.parent) {
        flags |= Qt::FramelessWindowHint;
        if (window.topmost) {
            flags |= Qt::WindowStaysOnTopHint | Qt::X11BypassWindowManagerHint;
        }
    } else if (!mayBeForeign(window.parent)) {
        flags |= Qt::WindowDoesNotAcceptFocus; // the keyboard stays with the top-level window
    } else if (!window.enabled) {
        // On the desktop a window manager would take it for a window of its own to look after.
        flags |= Qt::WindowTransparentForInput | Qt::WindowDoesNotAcceptFocus |
                 Qt::X11BypassWindowManagerHint;
    }
    return flags;
}

std::unique_ptr<NativeWindow> makeNative(const Window& window) {
    const Window* parent = findWindow(window.parent);
    const QRect place = placeOnScreen(window);
    QWindow* host = parent != nullptr ? toolkitWindow(*parent) : nullptr;
    if (parent == nullptr && window.parent) {
        host = QWindow::fromWinId(window.parent.number);
    }
    auto native = std::make_unique<NativeWindow>(window.handle, place, flagsOf(window), host);
    native->setTitle(shownText(window.title));
    if (!window.enabled && window.parent == GetDesktopWindow()) {
        native->lower();
    }
    if (!window.parent && !window.topmost) { // no window manager would show that of a topmost one
        native->setIcon(iconOf(window.windowClass->icon));
    }
    return native;
}

/// Runs WM_CREATE and what follows it; false if it refused or destroyed its window.
bool bringUp(HWND handle, CREATESTRUCTA& creation) {
    if (SendMessageA(handle, WM_CREATE, 0, reinterpret_cast<LPARAM>(&creation)) == -1) {
        DestroyWindow(handle);
        return false;
    }
    const Window* window = findWindow(handle);
    if (window != nullptr) {
        sendSizeAndPlace(*window);
    }
    return findWindow(handle) != nullptr;
}

} // namespace

} // namespace seam

using namespace seam;

WORD RegisterClassA(const WNDCLASSA* windowClass) {
    const std::string name =
        windowClass->lpszClassName == nullptr ? "" : windowClass->lpszClassName;
    if (name.empty() || windowClass->lpfnWndProc == nullptr || classes().contains(name)) {
        return 0;
    }
    classes()[name] = {name,
                       windowClass->style,
                       windowClass->lpfnWndProc,
                       windowClass->hInstance,
                       windowClass->hIcon,
                       windowClass->hCursor,
                       windowClass->hbrBackground};
    return static_cast<WORD>(classes().size());
}

void seam::forgetClass(const std::string& name) {
    classes().erase(name);
}

static bool namesButton(const char* className) {
    return className != nullptr && strcasecmp(className, "button") == 0;
}

static HWND makeFrameButton(const Window& host, const char* title, DWORD style, const Place& place,
                            HINSTANCE instance) {
    ControlTemplate made{0, "button", title == nullptr ? "" : title, place, style, {}};
    return addControl(made, host.handle, instance, *host.frame);
}

HWND CreateWindowExA(DWORD exStyle, const char* className, const char* title, DWORD style, int x,
                     int y, int width, int height, HWND parent, HMENU menu, HINSTANCE instance,
                     void* parameter) {
    const auto windowClass = classes().find(className == nullptr ? "" : className);
    const bool child = (style & WS_CHILD) != 0;
    if (const Window* host = findWindow(parent);
        child && host != nullptr && host->frame && namesButton(className)) {
        return makeFrameButton(*host, title, style, {x, y, width, height}, instance);
    }
    if (windowClass == classes().end() ||
        (child && findWindow(parent) == nullptr && !foreignExists(parent)) || !toolkit()) {
        return {};
    }
    auto made = std::make_unique<Window>();
    Window& window = *made;
    window.windowClass = &windowClass->second;
    window.instance = windowClass->second.instance;
    window.parent = child ? parent : HWND{};
    window.owner = !child && findWindow(parent) != nullptr ? topLevelOf(parent) : HWND{};
    window.style = style;
    window.enabled = (style & WS_DISABLED) == 0;
    window.topmost = (exStyle & WS_EX_TOPMOST) != 0;
    window.title = title == nullptr ? "" : title;
    const bool framed = !child && !window.topmost && (style & WS_BORDER) != 0;
    window.border = framed ? FrameWindow::border : 0;
    const int least = 1 + 2 * window.border;
    window.place = {x, y, x + std::max(width, least), y + std::max(height, least)};
    const HWND handle = addWindow(std::move(made));
    if (!handle) {
        return {};
    }
    if (framed) {
        window.frame = makeFrame(window);
    } else {
        window.native = makeNative(window);
    }
    if (mayBeForeign(window.parent)) {
        followHost(window.parent, handle);
    } else if (!child) {
        joinRoster(window);
    }
    CREATESTRUCTA creation{
        parameter, instance,  menu,   parent, height, width, y, x, static_cast<LONG>(style),
        title,     className, exStyle};
    if (!bringUp(handle, creation)) {
        return {};
    }
    if ((style & WS_VISIBLE) != 0) {
        showWindow(handle);
    }
    return findWindow(handle) != nullptr ? handle : HWND{};
}

DWORD SetClassLongA(HWND window, int index, LONG value) {
    Window* found = findWindow(window);
    if (found == nullptr || index != GCL_HCURSOR) {
        return 0;
    }
    const DWORD before = found->windowClass->cursor.number;
    found->windowClass->cursor = HCURSOR{static_cast<DWORD>(value)};
    return before;
}

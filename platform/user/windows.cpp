// Classes and windows: making, finding and destroying them.
#include "platform/user/window.h"

#include "platform/gdi/surface.h"
#include "platform/harness.h"
#include "platform/trace.h"
#include "platform/user/activation.h"
#include "platform/user/controls/control.h"
#include "platform/user/dialog.h"
#include "platform/user/foreign.h"
#include "platform/user/frame_window.h"
#include "platform/user/icons.h"
#include "platform/user/menus.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/roster.h"
#include "platform/user/screens.h"
#include "platform/user/text.h"
#include "platform/user/timers.h"
#include "platform/user/toolkit.h"

#include <algorithm>
#include <map>
#include <strings.h>
#include <vector>

namespace seam {

namespace {

// Neither is ever freed: windows may be destroyed when the process exits.

HandleTable<Window>& table() {
    static auto* const windows = new HandleTable<Window>(HandleKind::window);
    return *windows;
}

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

/// Everything that lies in the window or is owned by it, the innermost last.
std::vector<HWND> withChildren(HWND window) {
    std::vector<HWND> found{window};
    for (std::size_t i = 0; i < found.size(); ++i) {
        forEachWindow([&](const Window& other) {
            if (other.parent == found[i] || other.owner == found[i]) {
                found.push_back(other.handle);
            }
        });
    }
    return found;
}

/// The next one of them to be told of its end; null when all have been. A handler may have made
/// another one.
HWND firstNotDying(HWND window) {
    for (const HWND one : withChildren(window)) {
        const Window* record = findWindow(one);
        if (record != nullptr && !record->dying) {
            return one;
        }
    }
    return {};
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

/// The keyboard goes back to the owner, or else to any other window; without a window manager
/// nobody else sees to that.
void passActivationOn(const Window& window) {
    const QWindow* native = toolkitWindow(window);
    if (window.parent || native == nullptr || !native->isActive()) {
        return;
    }
    QWindow* next = nullptr;
    bool ownerFound = false;
    forEachWindow([&](const Window& other) {
        if (!ownerFound && !other.parent && other.visible && !other.dying && other.enabled) {
            next = toolkitWindow(other);
            ownerFound = other.handle == window.owner;
        }
    });
    if (next != nullptr) {
        activate(*next);
    }
}

void removeWindow(HWND handle) {
    const Window* window = findWindow(handle);
    if (window != nullptr && window->dialog) {
        queuePosted({}); // the loop that it runs may be waiting
    }
    if (window == nullptr) {
        return; // a handler of its end has taken its owner away, and it with it
    }
    passActivationOn(*window);
    killTimersOf(handle);
    forgetMessagesOf(handle);
    forgetFocus(handle);
    leaveRoster(handle);
    leaveHost(handle);
    leaveScreens(handle); // while there is a window to take back what it holds from
    const HMENU menu = window->menu;
    QWidget* widget = window->control ? &window->control->widget() : nullptr;
    table().take(handle.number);
    delete widget;
    destroyMenuTree(menu);
}

} // namespace

Window::Window() = default;
Window::~Window() = default;

Window* findWindow(HWND window) {
    return table().find(window.number);
}

HWND addWindow(std::unique_ptr<Window> window) {
    Window& added = *window;
    const HWND handle{table().add(std::move(window))};
    if (handle) {
        added.handle = handle;
    }
    return handle;
}

WindowPicture* Window::picture() const {
    return frame ? static_cast<WindowPicture*>(frame.get()) : native.get();
}

QWindow* toolkitWindow(const Window& window) {
    return window.native ? window.native.get() : widgetOf(window).window()->windowHandle();
}

void forEachWindow(const std::function<void(Window&)>& visit) {
    table().forEach([&](DWORD, Window& window) { visit(window); });
}

HWND topLevelOf(HWND window) {
    const Window* found = findWindow(window);
    return found != nullptr && findWindow(found->parent) != nullptr ? topLevelOf(found->parent)
                                                                    : window;
}

static void invalidateChildren(const Window& window, const RECT& area, bool erase) {
    forEachWindow([&](Window& child) {
        if (child.parent == window.handle && child.picture() != nullptr) {
            const RECT& place = child.place;
            invalidate(child,
                       {area.left - place.left, area.top - place.top, area.right - place.left,
                        area.bottom - place.top},
                       erase);
        }
    });
}

void invalidate(Window& window, RECT area, bool erase) {
    area = {std::max(area.left, 0), std::max(area.top, 0), std::min(area.right, window.width()),
            std::min(area.bottom, window.height())};
    if (area.left >= area.right || area.top >= area.bottom) {
        return;
    }
    if (window.picture() == nullptr) {
        widgetOf(window).update(); // it paints itself: a WM_PAINT would never be answered
        return;
    }
    const RECT& old = window.update;
    window.update = window.paintNeeded
                        ? RECT{std::min(area.left, old.left), std::min(area.top, old.top),
                               std::max(area.right, old.right), std::max(area.bottom, old.bottom)}
                        : area;
    window.eraseNeeded = window.eraseNeeded || erase;
    window.paintNeeded = true;
    if ((window.style & WS_CLIPCHILDREN) == 0) {
        invalidateChildren(window, area, erase);
    }
    wake();
}

void windowResized(Window& window, int width, int height) {
    window.place.right = window.place.left + width + 2 * window.border;
    window.place.bottom = window.place.top + height + 2 * window.border;
    invalidate(window, {0, 0, width, height}, true);
    queuePosted({window.handle, WM_SIZE, 0, static_cast<LPARAM>(MAKELONG(width, height)), 0});
}

void countUserHandles(HandleCounts& counts) {
    counts.windows = table().live();
    counts.timers = liveTimers();
    counts.menus = liveMenus();
}

HandleCounts liveHandles() {
    HandleCounts counts;
    countKernelHandles(counts);
    countGdiHandles(counts);
    countUserHandles(counts);
    return counts;
}

Picture windowPicture(HWND window) {
    Picture picture;
    const Window* found = findWindow(window);
    if (found == nullptr || found->picture() == nullptr) {
        return picture;
    }
    const PixelView view = found->picture()->pixels();
    picture.width = view.width;
    picture.height = view.height;
    for (int y = 0; y < view.height; ++y) {
        const DWORD* row = view.bits + static_cast<std::ptrdiff_t>(y) * view.stride;
        std::transform(row, row + view.width, std::back_inserter(picture.pixels),
                       [](DWORD pixel) { return pixel & 0xFFFFFF; });
    }
    return picture;
}

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

BOOL DestroyWindow(HWND window) {
    Window* found = findWindow(window);
    if (found == nullptr || found->dying) {
        return FALSE;
    }
    while (HWND next = firstNotDying(window)) {
        findWindow(next)->dying = true;
        SendMessageA(next, WM_DESTROY, 0, 0);
    }
    const std::vector<HWND> doomed = withChildren(window);
    std::for_each(doomed.rbegin(), doomed.rend(), removeWindow);
    return TRUE;
}

BOOL IsWindow(HWND window) {
    return findWindow(window) != nullptr || isRemote(window) || foreignExists(window) ? TRUE
                                                                                      : FALSE;
}

HWND GetParent(HWND window) {
    const Window* found = findWindow(window);
    if (found == nullptr) {
        return {};
    }
    return found->parent ? found->parent : found->owner;
}

HWND FindWindowA(const char* className, const char* title) {
    HWND result;
    forEachWindow([&](const Window& window) {
        if (!result && !window.parent && !window.dying && window.windowClass->name == className &&
            (title == nullptr || window.title == title)) {
            result = window.handle;
        }
    });
    return result || title == nullptr ? result : findRemote(className, title);
}

LONG GetWindowLongA(HWND window, int index) {
    const Window* found = findWindow(window);
    return found == nullptr || index != GWL_HINSTANCE ? 0
                                                      : static_cast<LONG>(found->instance.number);
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

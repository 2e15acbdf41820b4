// The windows of this program: finding and destroying them, and what has to be painted in them.
#include "platform/user/window.h"

#include "platform/gdi/surface.h"
#include "platform/harness.h"
#include "platform/trace.h"
#include "platform/user/activation.h"
#include "platform/user/controls/control.h"
#include "platform/user/dialog.h"
#include "platform/user/foreign.h"
#include "platform/user/frame_window.h"
#include "platform/user/menus.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/roster.h"
#include "platform/user/screens.h"
#include "platform/user/timers.h"

#include <algorithm>
#include <vector>

namespace seam {

namespace {

/// Never freed: windows may be destroyed when the process exits.
HandleTable<Window>& table() {
    static auto* const windows = new HandleTable<Window>(HandleKind::window);
    return *windows;
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

#include "platform/user/foreign.h"

#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/reply.h"
#include "platform/user/scale.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QAbstractNativeEventFilter>
#include <QGuiApplication>

#include <cstring>
#include <string_view>
#include <vector>
#include <xcb/xcb.h>

namespace seam {

namespace {

/// A size that the X server tells as ours: of what isn't whole there must be no strip left.
QSize ourSize(int width, int height) {
    const int scale = primaryScale();
    return {(width + scale - 1) / scale, (height + scale - 1) / scale};
}

struct Host {
    xcb_window_t parent;
    xcb_window_t childId;
    HWND child;
};

/// Follows the windows of other programs that ours lie in.
class HostFilter : public QAbstractNativeEventFilter {
  public:
    void follow(const Host& host) {
        hosts_.push_back(host);
    }

    bool nativeEventFilter(const QByteArray& type, void* message, qintptr* /*result*/) override {
        if (type != "xcb_generic_event_t") {
            return false;
        }
        const auto* event = static_cast<const xcb_generic_event_t*>(message);
        switch (event->response_type & 0x7F) {
        case XCB_DESTROY_NOTIFY:
            destroyed(reinterpret_cast<const xcb_destroy_notify_event_t*>(event)->window);
            break;
        case XCB_CONFIGURE_NOTIFY: {
            const auto* configured = reinterpret_cast<const xcb_configure_notify_event_t*>(event);
            resized(configured->window, ourSize(configured->width, configured->height));
            break;
        }
        default:
            break;
        }
        return false;
    }

    void forget(HWND child) {
        std::erase_if(hosts_, [child](const Host& host) { return host.child == child; });
    }

  private:
    void destroyed(xcb_window_t id) {
        for (const Host& host : hosts_) {
            if (host.parent == id || host.childId == id) {
                queuePosted({host.child, WM_CLOSE, 0, 0, 0});
            }
        }
        std::erase_if(hosts_,
                      [id](const Host& host) { return host.parent == id || host.childId == id; });
    }

    void resized(xcb_window_t id, QSize size) {
        for (const Host& host : hosts_) {
            Window* child = host.parent == id ? findWindow(host.child) : nullptr;
            if (child != nullptr && child->native) {
                child->native->resize(size);
            }
        }
    }

    std::vector<Host> hosts_;
};

HostFilter& hostFilter() {
    static auto* const filter = [] {
        auto* made = new HostFilter; // kept, like the application object, until the process ends
        QCoreApplication::instance()->installNativeEventFilter(made);
        return made;
    }();
    return *filter;
}

/// The number of a name; XCB_ATOM_NONE if nobody has used it yet.
xcb_atom_t atomOf(xcb_connection_t* connection, std::string_view name) {
    const auto request =
        xcb_intern_atom(connection, 1, static_cast<std::uint16_t>(name.size()), name.data());
    const auto atom = own(xcb_intern_atom_reply(connection, request, nullptr));
    return atom == nullptr ? xcb_atom_t{XCB_ATOM_NONE} : atom->atom;
}

/// The window that a property names; 0 if there is none.
xcb_window_t windowProperty(xcb_connection_t* connection, xcb_window_t window, xcb_atom_t name) {
    if (name == XCB_ATOM_NONE) {
        return 0;
    }
    const auto request =
        xcb_get_property(connection, 0, window, name, XCB_GET_PROPERTY_TYPE_ANY, 0, 1);
    const auto property = own(xcb_get_property_reply(connection, request, nullptr));
    xcb_window_t named = 0;
    if (property != nullptr && xcb_get_property_value_length(property.get()) == sizeof named) {
        std::memcpy(&named, xcb_get_property_value(property.get()), sizeof named);
    }
    return named;
}

/// Asks to be told of a window's size and end, beside what this connection is told of it already:
/// the toolkit follows the root window. Whether there is such a window.
bool watchStructure(xcb_connection_t* connection, xcb_window_t window) {
    const auto now = own(xcb_get_window_attributes_reply(
        connection, xcb_get_window_attributes(connection, window), nullptr));
    if (now == nullptr) {
        return false;
    }
    const std::uint32_t mask = now->your_event_mask | XCB_EVENT_MASK_STRUCTURE_NOTIFY;
    const auto request =
        xcb_change_window_attributes_checked(connection, window, XCB_CW_EVENT_MASK, &mask);
    // It may have gone since we looked: the error is ours to take, not the toolkit's to print.
    return own(xcb_request_check(connection, request)) == nullptr;
}

} // namespace

bool foreignExists(HWND window) {
    xcb_connection_t* connection = mayBeForeign(window) ? xConnection() : nullptr;
    if (connection == nullptr) {
        return false;
    }
    return own(xcb_get_window_attributes_reply(connection,
                                               xcb_get_window_attributes(connection, window.number),
                                               nullptr)) != nullptr;
}

bool foreignSize(HWND window, SIZE& size) {
    xcb_connection_t* connection = mayBeForeign(window) ? xConnection() : nullptr;
    if (connection == nullptr) {
        return false;
    }
    const auto geometry = own(
        xcb_get_geometry_reply(connection, xcb_get_geometry(connection, window.number), nullptr));
    if (geometry == nullptr) {
        return false;
    }
    const QSize ours = ourSize(geometry->width, geometry->height);
    size = {ours.width(), ours.height()};
    return true;
}

bool windowsAreManaged() {
    xcb_connection_t* connection = xConnection();
    if (connection == nullptr) {
        return true;
    }
    // A window manager tells of itself by a property of the root window, which outlives it: the id
    // of a window that doesn't.
    const xcb_atom_t check = atomOf(connection, "_NET_SUPPORTING_WM_CHECK");
    return foreignExists(HWND{windowProperty(connection, rootWindow(connection), check)});
}

HWND foreignDesktop() {
    xcb_connection_t* connection = xConnection();
    if (connection == nullptr) {
        return {};
    }
    const xcb_window_t root = rootWindow(connection);
    const xcb_atom_t virtualRoot = atomOf(connection, "__SWM_VROOT");
    if (virtualRoot != XCB_ATOM_NONE) {
        // It stands on the window itself, a child of the root window.
        const auto tree =
            own(xcb_query_tree_reply(connection, xcb_query_tree(connection, root), nullptr));
        const int count = tree == nullptr ? 0 : xcb_query_tree_children_length(tree.get());
        for (int i = 0; i < count; ++i) {
            const xcb_window_t child = xcb_query_tree_children(tree.get())[i];
            const HWND named{windowProperty(connection, child, virtualRoot)};
            if (foreignExists(named)) {
                return named;
            }
        }
    }
    return HWND{root};
}

HWND foreignFocus() {
    xcb_connection_t* connection = xConnection();
    if (connection == nullptr) {
        return {};
    }
    const auto focus =
        own(xcb_get_input_focus_reply(connection, xcb_get_input_focus(connection), nullptr));
    // 0 and 1 stand for no window and for the one under the pointer.
    return focus == nullptr || focus->focus <= 1 ? HWND{} : HWND{focus->focus};
}

void followHost(HWND parent, HWND child) {
    xcb_connection_t* connection = xConnection();
    const Window* window = findWindow(child);
    if (connection == nullptr || window == nullptr || !window->native) {
        return;
    }
    const bool watched = watchStructure(connection, parent.number);
    hostFilter().follow({parent.number, static_cast<xcb_window_t>(window->native->winId()), child});
    SIZE size{};
    if (!watched || !foreignSize(parent, size)) {
        queuePosted({child, WM_CLOSE, 0, 0, 0});
        return;
    }
    window->native->resize(size.cx, size.cy); // it may have changed before we were told of changes
}

void leaveHost(HWND child) {
    if (qGuiApp != nullptr) {
        hostFilter().forget(child);
    }
}

} // namespace seam

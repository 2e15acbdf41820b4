// The pointer confined to a part of the screen. The X server knows how to confine it to a window
// only, so there is one that nobody sees: it has no picture, and lies below all others.
#include "platform/user.h"
#include "platform/user/reply.h"
#include "platform/user/scale.h"
#include "platform/user/toolkit.h"

#include <QCoreApplication>
#include <QEvent>
#include <QSize>

#include <string_view>
#include <xcb/xcb.h>

using namespace seam;

static xcb_window_t clipWindow = XCB_NONE;

/// The pointer has the shape of the window that holds it: the arrow of the X server's cursor font.
static void showArrow(xcb_connection_t* connection) {
    constexpr std::string_view fontName = "cursor";
    constexpr std::uint16_t arrow = 68;
    constexpr std::uint16_t white = 0xFFFF;
    const xcb_font_t font = xcb_generate_id(connection);
    xcb_open_font(connection, font, fontName.size(), fontName.data());
    const xcb_cursor_t cursor = xcb_generate_id(connection);
    xcb_create_glyph_cursor(connection, cursor, font, font, arrow, arrow + 1, 0, 0, 0, white, white,
                            white);
    xcb_change_window_attributes(connection, clipWindow, XCB_CW_CURSOR, &cursor);
    xcb_free_cursor(connection, cursor);
    xcb_close_font(connection, font);
}

static void makeClipWindow(xcb_connection_t* connection, const RECT& area) {
    // Places on the server count its pixels, but for the primary screen's corner, which is the
    // same.
    const int scale = primaryScale();
    const QPoint corner = QPoint(area.left, area.top) * scale + screenOrigin();
    const QSize size = QSize(area.right - area.left, area.bottom - area.top) * scale;
    const std::uint32_t overrides = 1; // out of the window manager's hands
    clipWindow = xcb_generate_id(connection);
    xcb_create_window(connection, 0, clipWindow, rootWindow(connection),
                      static_cast<std::int16_t>(corner.x()), static_cast<std::int16_t>(corner.y()),
                      static_cast<std::uint16_t>(size.width()),
                      static_cast<std::uint16_t>(size.height()), 0, XCB_WINDOW_CLASS_INPUT_ONLY,
                      XCB_COPY_FROM_PARENT, XCB_CW_OVERRIDE_REDIRECT, &overrides);
    showArrow(connection);
    const std::uint32_t below = XCB_STACK_MODE_BELOW;
    xcb_configure_window(connection, clipWindow, XCB_CONFIG_WINDOW_STACK_MODE, &below);
    xcb_map_window(connection, clipWindow);
}

/// Our windows go on getting what happens over them.
static bool confine(xcb_connection_t* connection) {
    const auto request = xcb_grab_pointer(
        connection, 1, clipWindow, XCB_EVENT_MASK_BUTTON_PRESS | XCB_EVENT_MASK_BUTTON_RELEASE,
        XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC, clipWindow, XCB_NONE, XCB_CURRENT_TIME);
    const auto reply = own(xcb_grab_pointer_reply(connection, request, nullptr));
    return reply != nullptr && reply->status == XCB_GRAB_STATUS_SUCCESS;
}

static void release(xcb_connection_t* connection) {
    if (clipWindow != XCB_NONE) {
        xcb_ungrab_pointer(connection, XCB_CURRENT_TIME);
        xcb_destroy_window(connection, clipWindow);
        clipWindow = XCB_NONE;
    }
}

namespace {

/// Another program may hold the pointer for a moment, as an open menu does: this tries again
/// whenever a window of ours sees the pointer.
class SecondTry : public QObject {
  protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        const bool sees = event->type() == QEvent::Enter || event->type() == QEvent::MouseMove ||
                          event->type() == QEvent::MouseButtonRelease;
        if (sees && watched->isWindowType() && confine(xConnection())) {
            QCoreApplication::instance()->removeEventFilter(this);
        }
        return false;
    }
};

} // namespace

/// Kept, like the application object, until the process ends.
static SecondTry& secondTry() {
    static auto* const instance = new SecondTry;
    return *instance;
}

BOOL ClipCursor(const RECT* area) {
    xcb_connection_t* connection = xConnection();
    if (connection == nullptr) {
        return FALSE;
    }
    release(connection);
    QCoreApplication::instance()->removeEventFilter(&secondTry());
    bool done = true;
    if (area != nullptr) {
        makeClipWindow(connection, *area);
        done = confine(connection);
        if (!done) {
            QCoreApplication::instance()->installEventFilter(&secondTry());
        }
    }
    xcb_flush(connection);
    return done ? TRUE : FALSE;
}

#include "platform/user/screens.h"

#include "platform/user/activation.h"
#include "platform/user/cursors.h"
#include "platform/user/grabs.h"
#include "platform/user/native_window.h"
#include "platform/user/reply.h"
#include "platform/user/scale.h"
#include "platform/user/sleep_lock.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QAbstractNativeEventFilter>
#include <QElapsedTimer>
#include <QGuiApplication>
#include <QMouseEvent>
#include <QScreen>
#include <QTimer>

#include <algorithm>
#include <memory>
#include <xcb/xcb.h>

namespace seam {

namespace {

/// Two programs that both want to be on top must not keep the machine busy.
constexpr int raiseMilliseconds = 100;

/// The time that a window manager may take to give a new window the keyboard.
constexpr int settleMilliseconds = 500;

/// Puts a window right below another one; both are out of the window manager's hands.
void putBelow(QWindow& window, QWindow& upper) {
    xcb_connection_t* connection = xConnection();
    if (connection != nullptr) {
        const std::uint32_t values[] = {static_cast<std::uint32_t>(upper.winId()),
                                        XCB_STACK_MODE_BELOW};
        xcb_configure_window(connection, static_cast<xcb_window_t>(window.winId()),
                             XCB_CONFIG_WINDOW_SIBLING | XCB_CONFIG_WINDOW_STACK_MODE,
                             static_cast<const std::uint32_t*>(values));
    }
}

/// Raises the windows in front, the foremost first and the others to right below the one before:
/// what is covered on the way would have to be shown anew.
void raiseAll() {
    const std::vector<QWindow*>& windows = windowsInFront();
    if (windows.empty()) {
        return;
    }
    windows.back()->raise();
    for (std::size_t i = windows.size() - 1; i > 0; --i) {
        putBelow(*windows[i - 1], *windows[i]);
    }
}

/// One black window behind the saver's, as large as all monitors together. The X server paints it:
/// it has no picture of its own.
class Cover : public QWindow {
  public:
    Cover(QWindow& front, const QRect& place) : front_(front) {
        setFlags(Qt::Window | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint |
                 Qt::X11BypassWindowManagerHint | Qt::WindowDoesNotAcceptFocus);
        create();
        placeOnServer(*this, place);
        if (xcb_connection_t* connection = xConnection()) {
            const auto id = static_cast<xcb_window_t>(winId());
            const std::uint32_t black = 0;
            xcb_change_window_attributes(connection, id, XCB_CW_BACK_PIXEL, &black);
        }
        putBelow(*this, front);
        applyCursor(*this);
        show();
    }

  protected:
    bool event(QEvent* event) override {
        switch (event->type()) {
        case QEvent::MouseMove:
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonRelease: {
            const auto& mouse = *static_cast<QMouseEvent*>(event);
            QMouseEvent moved(mouse.type(), front_.mapFromGlobal(mouse.globalPosition()),
                              mouse.globalPosition(), mouse.button(), mouse.buttons(),
                              mouse.modifiers());
            return QCoreApplication::sendEvent(&front_, &moved);
        }
        case QEvent::KeyPress:
        case QEvent::KeyRelease:
        case QEvent::Wheel:
        case QEvent::Close:
            return QCoreApplication::sendEvent(&front_, event);
        default:
            return QWindow::event(event);
        }
    }

  private:
    QWindow& front_;
};

class Screens : public QObject, public QAbstractNativeEventFilter {
  public:
    explicit Screens(Window& window) : owner_(window.handle), native_(*window.native) {
        const auto later = [this] {
            QMetaObject::invokeMethod(
                this, [this] { arrange(); }, Qt::QueuedConnection);
        };
        const auto follow = [this, later](QScreen* screen) {
            connect(screen, &QScreen::geometryChanged, this, later);
        };
        for (QScreen* screen : QGuiApplication::screens()) {
            follow(screen);
        }
        connect(qGuiApp, &QGuiApplication::screenAdded, this, follow);
        connect(qGuiApp, &QGuiApplication::screenAdded, this, later);
        connect(qGuiApp, &QGuiApplication::screenRemoved, this, later);
        connect(qGuiApp, &QGuiApplication::primaryScreenChanged, this, later);
        raiseLater_.setSingleShot(true);
        connect(&raiseLater_, &QTimer::timeout, this, [this] { raise(); });
        sinceTaken_.start();
        watchRoot();
        arrange();
    }

    HWND owner() const {
        return owner_;
    }

    int settlesIn() const {
        return std::max(settleMilliseconds - static_cast<int>(sinceTaken_.elapsed()), 0);
    }

    QWindow* cover() const {
        return cover_.get();
    }

    void raise() {
        sinceRaise_.start();
        raiseAll();
        if (cover_) {
            putBelow(*cover_, native_);
        }
        if (xcb_connection_t* connection = xConnection()) {
            xcb_flush(connection); // nothing else may wake us for a while
        }
    }

    bool nativeEventFilter(const QByteArray& type, void* message, qintptr* /*result*/) override {
        if (type == "xcb_generic_event_t") {
            const auto* event = static_cast<const xcb_generic_event_t*>(message);
            const int kind = event->response_type & 0x7F;
            // Both begin alike: the window that is told, and the one that it is about.
            const auto* mapped = reinterpret_cast<const xcb_map_notify_event_t*>(event);
            if ((kind == XCB_MAP_NOTIFY || kind == XCB_CONFIGURE_NOTIFY) &&
                mapped->event == root_ && !isOurs(mapped->window)) {
                raiseSoon();
            }
        }
        return false;
    }

  private:
    static bool isOurs(xcb_window_t id) {
        const QWindowList windows = QGuiApplication::topLevelWindows();
        return std::any_of(windows.begin(), windows.end(), [id](const QWindow* window) {
            return window->handle() != nullptr && window->winId() == id;
        });
    }

    /// Asks the X server to tell what other programs' windows do, beside what the toolkit asks.
    void watchRoot() {
        xcb_connection_t* connection = xConnection();
        if (connection == nullptr) {
            return;
        }
        root_ = rootWindow(connection);
        const auto now = own(xcb_get_window_attributes_reply(
            connection, xcb_get_window_attributes(connection, root_), nullptr));
        if (now != nullptr) {
            const std::uint32_t mask = now->your_event_mask | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY;
            xcb_change_window_attributes(connection, root_, XCB_CW_EVENT_MASK, &mask);
            QCoreApplication::instance()->installNativeEventFilter(this);
        }
    }

    /// Puts the window on the primary monitor and the black on the others.
    void arrange() {
        const QScreen* primary = QGuiApplication::primaryScreen();
        if (native_.geometry() != primary->geometry()) {
            native_.setGeometry(primary->geometry());
            centreBoxes(primary->geometry());
        }
        QRect all;
        for (const QScreen* screen : QGuiApplication::screens()) {
            all |= serverPlace(*screen);
        }
        if (QRect(primary->geometry().topLeft(), native_.size() * scaleOf(*primary))
                .contains(all)) {
            cover_.reset();
        } else if (cover_ == nullptr) {
            cover_ = std::make_unique<Cover>(native_, all);
        } else {
            placeOnServer(*cover_, all);
        }
    }

    void centreBoxes(const QRect& area) {
        for (QWindow* window : windowsInFront()) {
            if (window != &native_) {
                window->setPosition(area.center() - QRect(QPoint(), window->size()).center());
            }
        }
    }

    void raiseSoon() {
        if (!sinceRaise_.isValid() || sinceRaise_.hasExpired(raiseMilliseconds)) {
            raise();
        } else if (!raiseLater_.isActive()) {
            raiseLater_.start(raiseMilliseconds);
        }
    }

    HWND owner_;
    NativeWindow& native_;
    std::unique_ptr<Cover> cover_;
    xcb_window_t root_ = 0;
    QTimer raiseLater_;
    QElapsedTimer sinceRaise_;
    QElapsedTimer sinceTaken_;
};

std::unique_ptr<Screens> screens;

} // namespace

bool fillsScreen(const Window& window) {
    return window.topmost && !window.parent && window.place.left == 0 && window.place.top == 0 &&
           window.width() == GetSystemMetrics(SM_CXSCREEN) &&
           window.height() == GetSystemMetrics(SM_CYSCREEN);
}

void takeScreens(Window& window) {
    screens = std::make_unique<Screens>(window);
    bringForward(*window.native);
}

void leaveScreens(HWND window) {
    if (screens && screens->owner() == window) {
        giveBack(*findWindow(window)->native);
        screens.reset();
    }
}

void raiseInFront(QWindow& window) {
    const std::vector<QWindow*>& windows = windowsInFront();
    if (screens && std::find(windows.begin(), windows.end(), &window) != windows.end()) {
        screens->raise();
        windows.back()->requestActivate(); // it holds the keyboard anyway
    } else {
        window.raise();
        activate(window);
    }
}

bool screensAreTaken() {
    return screens != nullptr;
}

int screensSettleIn() {
    return screens ? screens->settlesIn() : 0;
}

void pictureShown(HWND window) {
    const Window* shown = sleepLockIsHeld() ? findWindow(window) : nullptr;
    if (shown == nullptr || !screens || screens->owner() != window || shown->paintNeeded) {
        return;
    }
    if (xcb_connection_t* connection = xConnection()) {
        // Once the X server answers it has done all that it was told before.
        own(xcb_get_input_focus_reply(connection, xcb_get_input_focus(connection), nullptr));
    }
    releaseSleepLock();
}

QWindow* screenCover() {
    return screens ? screens->cover() : nullptr;
}

} // namespace seam

#include "platform/user/toolkit.h"

#include "platform/user/ending.h"
#include "platform/user/foreign.h"
#include "platform/user/ordered_input.h"
#include "platform/user/queue.h"
#include "platform/user/scale.h"
#include "platform/user/screens.h"
#include "platform/user/sleep_lock.h"
#include "platform/user/window.h"

#include <QPalette>
#include <QProxyStyle>
#include <QScreen>
#include <QStyleOption>
#include <QTimer>

#include <cerrno>
#include <cstdio>
#include <fontconfig/fontconfig.h>
#include <memory>
#include <system_error>
#include <thread>
#include <xcb/xcb.h>

namespace seam {

namespace {

int argumentCount = 1;
char programName[] = "dorbo";
char* arguments[] = {programName, nullptr};

/// A connection to the X server, closed in the end; null where another platform was asked for. The
/// toolkit ends the process where it finds no display, so we look first. The connection outlasts
/// the making of the toolkit's own: a bare server starts anew when its last client leaves.
using Probe = std::unique_ptr<xcb_connection_t, decltype(&xcb_disconnect)>;

Probe probeDisplay() {
    const QByteArray platform = qgetenv("QT_QPA_PLATFORM");
    if (platform.startsWith("offscreen") || platform.startsWith("minimal")) {
        return {nullptr, &xcb_disconnect};
    }
    if (!platform.startsWith("xcb")) {
        qputenv("QT_QPA_PLATFORM", "xcb"); // the one that this program is written for
    }
    return {xcb_connect(nullptr, nullptr), &xcb_disconnect};
}

/// The toolkit's classic look, but for three things: the room between a check box and its text, as
/// texts are cut to the dialog units that they have; the icon of a box, which grows with its text;
/// and what pictures of arrows are kept by. That would be the palette's number, which is another
/// for each widget, and each opening of a dialog would leave its pictures and their names behind.
class ClassicStyle : public QProxyStyle {
  public:
    ClassicStyle() : QProxyStyle(QStringLiteral("windows")) {}

    int pixelMetric(PixelMetric metric, const QStyleOption* option,
                    const QWidget* widget) const override {
        constexpr int spacing = 3;
        const int plain = QProxyStyle::pixelMetric(metric, option, widget);
        switch (metric) {
        case PM_CheckBoxLabelSpacing:
        case PM_RadioButtonLabelSpacing:
            return dialogLength(spacing);
        case PM_MessageBoxIconSize:
            return dialogLength(plain);
        default:
            return plain;
        }
    }

    void drawPrimitive(PrimitiveElement element, const QStyleOption* option, QPainter* painter,
                       const QWidget* widget) const override {
        if (element < PE_IndicatorArrowDown || element > PE_IndicatorArrowUp) {
            QProxyStyle::drawPrimitive(element, option, painter, widget);
            return;
        }
        QStyleOption arrow(*option);
        arrow.palette = QGuiApplication::palette();
        arrow.palette.setCurrentColorGroup(option->palette.currentColorGroup());
        QProxyStyle::drawPrimitive(element, &arrow, painter, widget);
    }
};

/// Grey dialogs with blue selections, whatever the desktop's theme.
QPalette classicPalette() {
    QPalette palette(QColor(192, 192, 192), QColor(192, 192, 192));
    palette.setColor(QPalette::Light, Qt::white);
    palette.setColor(QPalette::Midlight, QColor(223, 223, 223));
    palette.setColor(QPalette::Dark, QColor(128, 128, 128));
    palette.setColor(QPalette::Shadow, Qt::black);
    palette.setColor(QPalette::Base, Qt::white);
    palette.setColor(QPalette::Text, Qt::black);
    palette.setColor(QPalette::WindowText, Qt::black);
    palette.setColor(QPalette::ButtonText, Qt::black);
    palette.setColor(QPalette::Highlight, QColor(0, 0, 128));
    palette.setColor(QPalette::HighlightedText, Qt::white);
    for (const QPalette::ColorRole role :
         {QPalette::WindowText, QPalette::ButtonText, QPalette::Text}) {
        palette.setColor(QPalette::Disabled, role, QColor(128, 128, 128));
    }
    return palette;
}

void tellOfActivation(Qt::ApplicationState state);

/// Whether nobody else has the keyboard that has just been lost. Where a Wayland compositor stands
/// behind the X server it takes it back at once from a window that asks for it, and gives it when
/// it has seen that window: what was lost so soon is looked at again a little later. A window of
/// the compositor's own that has it is nobody to the X server.
bool keyboardMayComeBack() {
    const int wait = screensSettleIn();
    if (wait > 0) {
        QTimer::singleShot(wait, qGuiApp,
                           [] { tellOfActivation(QGuiApplication::applicationState()); });
        return true;
    }
    return screensAreTaken() && !foreignFocus();
}

/// Another program has got the keyboard, or this one has it again.
void tellOfActivation(Qt::ApplicationState state) {
    const WPARAM active = state == Qt::ApplicationActive ? TRUE : FALSE;
    if (active == FALSE && keyboardMayComeBack()) {
        return;
    }
    forEachWindow([&](const Window& window) {
        if (!window.parent && window.visible) {
            queueInput({window.handle, WM_ACTIVATEAPP, active, 0, 0});
        }
    });
}

/// The toolkit can run GLib's loop within its own, for the sake of libraries that we don't use.
/// Making that loop takes some 6 ms of the start.
void doWithoutGlib() {
    if (!qEnvironmentVariableIsSet("QT_NO_GLIB")) {
        qputenv("QT_NO_GLIB", "1");
    }
}

/// Reads the lists of fonts while the toolkit starts: the toolkit would do it at the first text,
/// and the first picture come 2 to 3 ms later. Fontconfig may be asked by several threads at once,
/// but it reads the environment, which nobody of ours changes from here on. Where no thread can be
/// had, the toolkit reads the lists itself. The process ends no sooner than the reading.
void readFontLists() {
    try {
        static const std::jthread reader([] { FcInit(); });
    } catch (const std::system_error&) {
    }
}

bool makeToolkit() {
    takeSleepLock();
    const Probe probe = probeDisplay();
    if (probe != nullptr && xcb_connection_has_error(probe.get()) != 0) {
        std::fprintf(stderr, "%s: there is no display to show anything on\n",
                     program_invocation_short_name);
        return false;
    }
    doWithoutGlib();
    chooseScale();
    if (probe != nullptr) {
        readFontLists();
    }
    QApplication::setStyle(new ClassicStyle);
    QApplication::setPalette(classicPalette());
    // It lives as long as the process: windows may be destroyed by handlers of static objects.
    new OrderedApplication(argumentCount, static_cast<char**>(arguments));
    QApplication::setQuitOnLastWindowClosed(false);
    QObject::connect(qGuiApp, &QGuiApplication::applicationStateChanged, tellOfActivation);
    catchSignals();
    return true;
}

} // namespace

bool toolkit() {
    static const bool made = QCoreApplication::instance() != nullptr || makeToolkit();
    return made;
}

QPoint screenOrigin() {
    static const QPoint origin = QGuiApplication::primaryScreen()->geometry().topLeft();
    return origin;
}

xcb_connection_t* xConnection() {
    if (!toolkit()) {
        return nullptr;
    }
    auto* x11 = qGuiApp->nativeInterface<QNativeInterface::QX11Application>();
    return x11 == nullptr ? nullptr : x11->connection();
}

std::uint32_t rootWindow(xcb_connection_t* connection) {
    return xcb_setup_roots_iterator(xcb_get_setup(connection)).data->root;
}

} // namespace seam

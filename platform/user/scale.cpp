#include "platform/user/scale.h"

#include "platform/user/reply.h"
#include "platform/user/toolkit.h"

#include <QGuiApplication>
#include <QScreen>
#include <QWindow>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <optional>
#include <xcb/xcb.h>

namespace seam {

namespace {

constexpr int largestScale = 8;
constexpr double plainDensity = 96; // dots to the inch
constexpr const char* ownVariable = "DORBO_SCALE";
constexpr const char* screensVariable = "QT_SCREEN_SCALE_FACTORS";
constexpr const char* allVariable = "QT_SCALE_FACTOR";

/// What the user has set; nothing if that can't be a scale.
std::optional<int> askedScale() {
    const QByteArray text = qgetenv(ownVariable);
    if (text.isEmpty()) {
        return std::nullopt;
    }
    int scale = 0;
    const auto [end, error] = std::from_chars(text.cbegin(), text.cend(), scale);
    if (error == std::errc() && end == text.cend() && scale >= 1 && scale <= largestScale) {
        return scale;
    }
    std::fprintf(stderr, "dorbo: %s is not a whole number from 1 to %d: %s\n", ownVariable,
                 largestScale, text.constData());
    return std::nullopt;
}

QByteArray wholePart(const QByteArray& factor) {
    return QByteArray::number(std::clamp(std::floor(factor.toDouble()), 1.0, double{largestScale}));
}

/// The toolkit rounds what it finds out by itself, but not what it is told: "2;1.5", or "DP-1=1.5".
QByteArray wholeParts(const QByteArray& factors) {
    QByteArrayList entries = factors.split(';');
    for (QByteArray& entry : entries) {
        const qsizetype value = entry.lastIndexOf('=') + 1;
        if (value < entry.size()) {
            entry = entry.left(value) + wholePart(entry.mid(value));
        }
    }
    return entries.join(';');
}

void takeWholeParts() {
    for (const char* variable : {"QT_SCALE_FACTOR_ROUNDING_POLICY", "QT_DPI_ADJUSTMENT_POLICY"}) {
        qunsetenv(variable);
    }
    if (qEnvironmentVariableIsSet(screensVariable)) {
        qputenv(screensVariable, wholeParts(qgetenv(screensVariable)));
    }
    if (!qEnvironmentVariableIsEmpty(allVariable)) {
        qputenv(allVariable, wholePart(qgetenv(allVariable)));
    }
    QGuiApplication::setHighDpiScaleFactorRoundingPolicy(
        Qt::HighDpiScaleFactorRoundingPolicy::Floor);
}

void fixScale(int scale) {
    for (const char* variable : {screensVariable, "QT_USE_PHYSICAL_DPI"}) {
        qunsetenv(variable);
    }
    qputenv("QT_ENABLE_HIGHDPI_SCALING", "0");
    qputenv("QT_FONT_DPI", "96");
    qputenv(allVariable, QByteArray::number(scale));
}

/// Of the X server's whole display, in its pixels; none without a server.
QSize displaySize() {
    xcb_connection_t* connection = xConnection();
    if (connection == nullptr) {
        return {};
    }
    const auto geometry = own(xcb_get_geometry_reply(
        connection, xcb_get_geometry(connection, rootWindow(connection)), nullptr));
    return geometry == nullptr ? QSize() : QSize(geometry->width, geometry->height);
}

int whole(double ratio) {
    return std::max(static_cast<int>(std::lround(ratio)), 1);
}

} // namespace

void chooseScale() {
    if (const auto scale = askedScale()) {
        fixScale(*scale);
    } else {
        takeWholeParts();
    }
}

int scaleOf(const QWindow& window) {
    return whole(window.devicePixelRatio());
}

int scaleOf(const QScreen& screen) {
    return whole(screen.devicePixelRatio());
}

int primaryScale() {
    return scaleOf(*QGuiApplication::primaryScreen());
}

QRect serverPlace(const QScreen& screen) {
    const QRect ours = screen.geometry();
    const int scale = scaleOf(screen);
    QRect place(ours.topLeft(), ours.size() * scale);
    const QSize display = displaySize();
    if (std::abs(display.width() - 1 - place.right()) < scale) {
        place.setRight(display.width() - 1);
    }
    if (std::abs(display.height() - 1 - place.bottom()) < scale) {
        place.setBottom(display.height() - 1);
    }
    return place;
}

void placeOnServer(QWindow& window, const QRect& place) {
    xcb_connection_t* connection = xConnection();
    if (connection == nullptr) {
        window.setGeometry(place);
        return;
    }
    const std::uint32_t values[] = {
        static_cast<std::uint32_t>(place.x()), static_cast<std::uint32_t>(place.y()),
        static_cast<std::uint32_t>(place.width()), static_cast<std::uint32_t>(place.height())};
    xcb_configure_window(connection, static_cast<xcb_window_t>(window.winId()),
                         XCB_CONFIG_WINDOW_X | XCB_CONFIG_WINDOW_Y | XCB_CONFIG_WINDOW_WIDTH |
                             XCB_CONFIG_WINDOW_HEIGHT,
                         static_cast<const std::uint32_t*>(values));
}

int dialogPercent() {
    const double density = QGuiApplication::primaryScreen()->logicalDotsPerInch();
    return std::max(static_cast<int>(std::lround(density / plainDensity * 100)), 100);
}

int dialogLength(int pixels) {
    return (pixels * dialogPercent() + 50) / 100;
}

} // namespace seam

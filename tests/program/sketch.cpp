#include "tests/program/sketch.h"

namespace ground {

QRect edges(int left, int top, int right, int bottom) {
    return {left, top, right - left, bottom - top};
}

void bevel(QPainter& sketch, QRect place, int depth) {
    const QColor first = depth > 0 ? dark : light;
    const QColor second = depth > 0 ? light : dark;
    for (int i = 0; i < std::abs(depth); ++i, place.adjust(1, 1, -1, -1)) {
        sketch.fillRect(QRect(place.topLeft(), QSize(place.width(), 1)), first);
        sketch.fillRect(QRect(place.topLeft(), QSize(1, place.height())), first);
        sketch.fillRect(QRect(place.topRight(), QSize(1, place.height())), second);
        sketch.fillRect(QRect(place.bottomLeft() + QPoint(2, 0), place.bottomRight()), second);
    }
}

void box(QPainter& sketch, const QRect& place, int depth, QRgb colour) {
    if (place.width() > 4) {
        const int rim = std::abs(depth);
        bevel(sketch, place, depth);
        sketch.fillRect(place.adjusted(rim, rim, -rim, -rim), QColor(colour));
    }
}

void pushButton(QPainter& sketch, const QRect& place) {
    const QRect inner = place.adjusted(1, 1, -1, -1);
    sketch.fillRect(place, QColor(black));
    sketch.fillRect(place.adjusted(0, 0, -1, -1), QColor(light));
    sketch.fillRect(inner, QColor(dark));
    sketch.fillRect(inner.adjusted(0, 0, -1, -1), QColor(face));
    sketch.fillRect(inner.adjusted(1, 1, -1, -1), anything);
}

std::string difference(const QImage& wanted, const QImage& shown) {
    for (int i = 0; i < wanted.width() * wanted.height(); ++i) {
        const QPoint at(i % wanted.width(), i / wanted.width());
        const QRgb colour = wanted.pixel(at);
        if (qAlpha(colour) != 0 && colour != shown.pixel(at)) {
            return QString::asprintf("at %d, %d stands %X for %X", at.x(), at.y(), shown.pixel(at),
                                     colour)
                .toStdString();
        }
    }
    return "";
}

std::set<QRgb> coloursOf(const QImage& picture) {
    const auto* pixels = reinterpret_cast<const QRgb*>(picture.constBits());
    return {pixels, pixels + picture.width() * picture.height()};
}

} // namespace ground

// What the screen should show, drawn without the program's help.
#pragma once

#include <set>
#include <string>

#include <QImage>
#include <QPainter>

namespace ground {

constexpr Qt::GlobalColor anything = Qt::transparent; // a pixel that isn't looked at
constexpr QRgb black = 0xFF000000;
constexpr QRgb dark = 0xFF808080;
constexpr QRgb face = 0xFFC0C0C0;
constexpr QRgb light = 0xFFFFFFFF;
constexpr QRgb blue = 0xFF000080;

/// From edges of which the right and the lower one lie outside.
QRect edges(int left, int top, int right, int bottom);

/// A positive depth is sunken. Each ring leaves out the second pixel of its lowest row.
void bevel(QPainter& sketch, QRect place, int depth);

/// A bevel and what fills it; nothing if it is no wider than 4 pixels.
void box(QPainter& sketch, const QRect& place, int depth, QRgb colour);

/// The toolkit's raised button, but for what stands in it.
void pushButton(QPainter& sketch, const QRect& place);

/// The first difference in words; empty if there is none.
std::string difference(const QImage& wanted, const QImage& shown);

std::set<QRgb> coloursOf(const QImage& picture);

} // namespace ground

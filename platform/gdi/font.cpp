#include "platform/gdi/font.h"

#include "platform/gdi/objects.h"

#include <QGuiApplication>

#include <array>
#include <cstdlib>
#include <strings.h>

namespace seam {

namespace {

constexpr int boldFrom = 600;
constexpr int normalWeight = 400;
constexpr int boldWeight = 700;
constexpr int defaultHeight = 12;

QFont makeFont(bool serif, bool bold, int pixels) {
    QFont font(serif ? QStringLiteral("Liberation Serif") : QStringLiteral("Liberation Sans"));
    font.setPixelSize(std::max(pixels, 1));
    font.setBold(bold);
    font.setKerning(false);
    font.setHintingPreference(QFont::PreferFullHinting);
    font.setStyleStrategy(static_cast<QFont::StyleStrategy>(
        QFont::NoAntialias | QFont::NoFontMerging | QFont::PreferNoShaping));
    return font;
}

/// The largest characters whose cell is not above the height.
QFont makeFontOfCell(bool serif, bool bold, int cell) {
    QFont font = makeFont(serif, bold, cell);
    for (int pixels = cell; pixels > 1 && QFontMetrics(font).height() > cell; --pixels) {
        font.setPixelSize(pixels - 1);
    }
    return font;
}

} // namespace

QFont dialogFont(int pixels) {
    QFont font = makeFont(false, false, pixels);
    if (qGuiApp != nullptr && qGuiApp->devicePixelRatio() > 1) {
        // Letters as wide as those of the smaller size, whose pixels are larger, would leave gaps.
        font.setHintingPreference(QFont::PreferVerticalHinting);
    }
    return font;
}

const FontFace& Font::face() const {
    if (!face_) {
        const bool bold = weight_ >= boldFrom;
        const QFont font = height_ > 0
                               ? makeFontOfCell(serif_, bold, height_)
                               : makeFont(serif_, bold, height_ == 0 ? defaultHeight : -height_);
        face_ = std::make_unique<FontFace>(FontFace{font, QFontMetrics(font)});
    }
    return *face_;
}

int Font::weight() const {
    return weight_ >= boldFrom ? boldWeight : normalWeight;
}

} // namespace seam

using namespace seam;

HFONT CreateFontA(int height, int width, int escapement, int orientation, int weight, DWORD italic,
                  DWORD underline, DWORD strikeOut, DWORD charSet, DWORD outputPrecision,
                  DWORD clipPrecision, DWORD quality, DWORD pitchAndFamily, const char* face) {
    constexpr int largestHeight = 1000;
    const DWORD style = italic | underline | strikeOut | charSet | outputPrecision | clipPrecision |
                        quality | pitchAndFamily;
    if (style != 0 || width != 0 || escapement != 0 || orientation != 0 || height > largestHeight ||
        height < -largestHeight) {
        return {};
    }
    const bool serif = face != nullptr && strcasecmp(face, "MS Serif") == 0;
    return HFONT{addObject(Font(height, weight, serif))};
}

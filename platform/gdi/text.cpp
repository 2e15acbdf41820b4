// Text on contexts, drawn by the toolkit's text engine straight into the target's pixels.
#include "platform/gdi/canvas.h"
#include "platform/gdi/encoding.h"
#include "platform/gdi/objects.h"
#include "platform/gdi/text_layout.h"

#include <QImage>
#include <QPainter>

#include <algorithm>
#include <cstring>
#include <optional>

using namespace seam;

namespace {

/// A line of a text with the place of its cells in the target.
struct PlacedLine {
    TextLine line;
    RECT cells;
};

struct PlacedText {
    PlainText plain;
    std::vector<PlacedLine> lines;
    int height = 0;
};

const FontFace* selectedFace(const DeviceContext* context) {
    const Font* const font = context == nullptr ? nullptr : findObjectAs<Font>(context->state.font);
    return font == nullptr ? nullptr : &font->face();
}

std::optional<std::size_t> textLength(const char* text, int length) {
    if (text == nullptr || length < -1) {
        return std::nullopt;
    }
    return length == -1 ? std::strlen(text) : static_cast<std::size_t>(length);
}

std::vector<TextLine> breakText(const QString& text, const TextMeasure& measure, int width,
                                UINT format) {
    if ((format & DT_SINGLELINE) != 0) {
        return {{0, text.size()}};
    }
    std::vector<TextLine> lines = splitLines(text);
    if ((format & DT_WORDBREAK) == 0) {
        return lines;
    }
    std::vector<TextLine> wrapped;
    for (const TextLine& line : lines) {
        const std::vector<TextLine> parts = wrapLine(text, line, measure, width);
        wrapped.insert(wrapped.end(), parts.begin(), parts.end());
    }
    return wrapped;
}

LONG firstTop(const RECT& area, int lineHeight, UINT format) {
    const bool centred = (format & DT_VCENTER) != 0 && (format & DT_SINGLELINE) != 0;
    return centred ? area.top + (area.bottom - area.top - lineHeight) / 2 : area.top;
}

PlacedText placeText(PlainText plain, const QFontMetrics& metrics, const RECT& area, UINT format) {
    PlacedText placed{std::move(plain), {}, 0};
    const TextMeasure measure(placed.plain.text, metrics);
    const int width = area.right - area.left;
    LONG top = firstTop(area, metrics.height(), format);
    for (const TextLine& line : breakText(placed.plain.text, measure, width, format)) {
        const int lineWidth = measure.width(line);
        const LONG left = area.left + ((format & DT_CENTER) != 0 ? (width - lineWidth) / 2 : 0);
        placed.lines.push_back({line, {left, top, left + lineWidth, top + metrics.height()}});
        top += metrics.height();
        placed.height += metrics.height();
    }
    return placed;
}

/// The bounds of what the text can change: its cells, and what glyphs reach beyond them.
RECT reachOf(const PlacedText& placed, int overhang) {
    RECT reach = placed.lines.front().cells;
    for (const PlacedLine& line : placed.lines) {
        reach = {std::min(reach.left, line.cells.left), std::min(reach.top, line.cells.top),
                 std::max(reach.right, line.cells.right),
                 std::max(reach.bottom, line.cells.bottom)};
    }
    InflateRect(&reach, overhang, overhang);
    return reach;
}

void drawUnderlines(const Canvas& canvas, const PlacedText& placed, const PlacedLine& line,
                    const FontFace& face, DWORD pixel) {
    const TextMeasure measure(placed.plain.text, face.metrics);
    const LONG top = line.cells.top + face.metrics.ascent() + 1;
    for (const qsizetype place : placed.plain.underlined) {
        if (place >= line.line.start && place < line.line.end) {
            const LONG left = line.cells.left + measure.width({line.line.start, place});
            const LONG right = left + measure.width({place, place + 1});
            fillArea(canvas, {left, top, right, top + 1}, pixel);
        }
    }
}

/// Draws the lines' glyphs within the canvas's clip, which isn't empty.
void drawGlyphs(const Canvas& canvas, const PlacedText& placed, const FontFace& face, DWORD pixel) {
    constexpr int bytesPerPixel = 4;
    QImage target(reinterpret_cast<uchar*>(canvas.view.bits), canvas.view.width, canvas.view.height,
                  static_cast<qsizetype>(canvas.view.stride) * bytesPerPixel, QImage::Format_RGB32);
    QPainter painter(&target);
    painter.setRenderHint(QPainter::TextAntialiasing, false);
    painter.setFont(face.font);
    painter.setPen(QColor(QRgb{pixel}));
    painter.setClipRect(canvas.clip.left, canvas.clip.top, canvas.clip.right - canvas.clip.left,
                        canvas.clip.bottom - canvas.clip.top);
    for (const PlacedLine& line : placed.lines) {
        const qsizetype length = line.line.end - line.line.start;
        if (!isEmpty(intersection(line.cells, canvas.clip))) {
            painter.drawText(line.cells.left, line.cells.top + face.metrics.ascent(),
                             placed.plain.text.mid(line.line.start, length));
        }
    }
}

/// Draws within the canvas's clip.
void drawPlaced(const DeviceContext& context, Canvas canvas, const PlacedText& placed,
                const FontFace& face) {
    canvas.clip = intersection(canvas.clip, reachOf(placed, face.metrics.height() / 2));
    if (isEmpty(canvas.clip)) {
        return;
    }
    touch(canvas, canvas.clip);
    const DWORD background = pixelOf(context, canvas, context.state.background);
    const DWORD ink = pixelOf(context, canvas, context.state.text);
    if (context.state.backgroundMode == OPAQUE) {
        for (const PlacedLine& line : placed.lines) {
            fillArea(canvas, line.cells, background);
        }
    }
    drawGlyphs(canvas, placed, face, ink);
    for (const PlacedLine& line : placed.lines) {
        drawUnderlines(canvas, placed, line, face, ink);
    }
}

} // namespace

int DrawTextA(HDC dc, const char* text, int length, RECT* rectangle, UINT format) {
    const DeviceContext* const context = findContext(dc);
    const FontFace* const face = selectedFace(context);
    const auto bytes = textLength(text, length);
    if (face == nullptr || !bytes || rectangle == nullptr) {
        return 0;
    }
    const PlacedText placed = placeText(readText(text, *bytes, (format & DT_NOPREFIX) == 0),
                                        face->metrics, *rectangle, format);
    Canvas canvas = canvasOf(*context);
    if ((format & DT_NOCLIP) == 0) {
        canvas.clip = intersection(canvas.clip, *rectangle);
    }
    if (!placed.lines.empty()) {
        drawPlaced(*context, canvas, placed, *face);
    }
    return placed.height;
}

BOOL GetTextExtentPointA(HDC dc, const char* text, int length, SIZE* size) {
    const FontFace* const face = selectedFace(findContext(dc));
    const auto bytes = textLength(text, length);
    if (face == nullptr || !bytes || length < 0 || size == nullptr) {
        return FALSE;
    }
    const QString decoded = fromWindows1252(text, *bytes);
    *size = {TextMeasure(decoded, face->metrics).width({0, decoded.size()}),
             face->metrics.height()};
    return TRUE;
}

BOOL GetTextMetricsA(HDC dc, TEXTMETRICA* metrics) {
    const DeviceContext* const context = findContext(dc);
    const FontFace* const face = selectedFace(context);
    if (face == nullptr || metrics == nullptr) {
        return FALSE;
    }
    const QFontMetrics& told = face->metrics;
    metrics->tmHeight = told.height();
    metrics->tmAscent = told.ascent();
    metrics->tmDescent = told.descent();
    metrics->tmInternalLeading = std::max(told.height() - face->font.pixelSize(), 0);
    metrics->tmExternalLeading = std::max(told.leading(), 0);
    metrics->tmAveCharWidth = told.averageCharWidth();
    metrics->tmMaxCharWidth = told.maxWidth();
    metrics->tmWeight = findObjectAs<Font>(context->state.font)->weight();
    return TRUE;
}

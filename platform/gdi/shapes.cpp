// Lines, rectangles and single pixels.
#include "platform/gdi/canvas.h"
#include "platform/gdi/objects.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <utility>

using namespace seam;

namespace {

/// A line in the direction in which it is longer (major) and across it (minor).
struct Line {
    std::int64_t major, minor; // where it starts
    std::int64_t length;       // pixels, without the end point
    std::int64_t rise;         // how far it goes across
    int step;                  // +1 or -1, along the major direction
    bool steep;                // the major direction is y

    std::int64_t minorAt(std::int64_t i) const {
        const auto steps = static_cast<std::uint64_t>(length);
        const auto product =
            static_cast<std::uint64_t>(i) * static_cast<std::uint64_t>(std::abs(rise));
        const bool roundUp = 2 * (product % steps) >= steps;
        const auto offset = static_cast<std::int64_t>(product / steps + (roundUp ? 1 : 0));
        return minor + (rise < 0 ? -offset : offset);
    }
};

Line makeLine(POINT from, POINT to) {
    const std::int64_t dx = std::int64_t{to.x} - from.x;
    const std::int64_t dy = std::int64_t{to.y} - from.y;
    const bool steep = std::abs(dy) > std::abs(dx);
    const std::int64_t along = steep ? dy : dx;
    return {steep ? from.y : from.x, steep ? from.x : from.y, std::abs(along),
            steep ? dx : dy,         along < 0 ? -1 : 1,      steep};
}

/// The pixels of the line that can lie in the clip, from `first` up to `last`.
std::pair<std::int64_t, std::int64_t> visiblePart(const Line& line, const RECT& clip) {
    const std::int64_t low = line.steep ? clip.top : clip.left;
    const std::int64_t high = line.steep ? clip.bottom : clip.right;
    const std::int64_t first = line.step > 0 ? low - line.major : line.major - (high - 1);
    const std::int64_t last = line.step > 0 ? high - line.major : line.major - low + 1;
    return {std::max<std::int64_t>(first, 0), std::min(last, line.length)};
}

RECT pixelArea(const Line& line, std::int64_t majorLow, std::int64_t majorHigh,
               std::int64_t minor) {
    const auto low = static_cast<LONG>(majorLow);
    const auto high = static_cast<LONG>(majorHigh);
    const auto across = static_cast<LONG>(minor);
    return line.steep ? RECT{across, low, across + 1, high + 1}
                      : RECT{low, across, high + 1, across + 1};
}

/// Draws the pixels from `first` to `last`, which lie on one row or column of pixels.
void drawRun(const Canvas& canvas, const Line& line, std::int64_t first, std::int64_t last,
             DWORD pixel) {
    const std::int64_t minor = line.minorAt(first);
    const std::int64_t low = line.steep ? canvas.clip.left : canvas.clip.top;
    const std::int64_t high = line.steep ? canvas.clip.right : canvas.clip.bottom;
    if (minor >= low && minor < high) {
        const std::int64_t a = line.major + first * line.step;
        const std::int64_t b = line.major + last * line.step;
        fillArea(canvas, pixelArea(line, std::min(a, b), std::max(a, b), minor), pixel);
    }
}

void drawLine(const Canvas& canvas, const Line& line, DWORD pixel) {
    const auto [first, end] = visiblePart(line, canvas.clip);
    if (first >= end) {
        return;
    }
    if (line.rise == 0) {
        drawRun(canvas, line, first, end - 1, pixel);
        return;
    }
    for (std::int64_t i = first; i < end; ++i) {
        drawRun(canvas, line, i, i, pixel);
    }
}

void outline(const Canvas& canvas, const RECT& area, DWORD pixel) {
    fillArea(canvas, {area.left, area.top, area.right, area.top + 1}, pixel);
    fillArea(canvas, {area.left, area.bottom - 1, area.right, area.bottom}, pixel);
    fillArea(canvas, {area.left, area.top, area.left + 1, area.bottom}, pixel);
    fillArea(canvas, {area.right - 1, area.top, area.right, area.bottom}, pixel);
}

} // namespace

BOOL LineTo(HDC dc, int x, int y) {
    DeviceContext* const context = findContext(dc);
    if (context == nullptr) {
        return FALSE;
    }
    const POINT from = std::exchange(context->state.position, POINT{x, y});
    const auto* const pen = findObjectAs<Pen>(context->state.pen);
    if (pen != nullptr && pen->visible) {
        const Canvas canvas = canvasOf(*context);
        drawLine(canvas, makeLine(from, {x, y}), pixelOf(*context, canvas, pen->colour));
    }
    return TRUE;
}

BOOL Rectangle(HDC dc, int left, int top, int right, int bottom) {
    const DeviceContext* const context = findContext(dc);
    if (context == nullptr) {
        return FALSE;
    }
    const RECT area{left, top, right, bottom};
    if (isEmpty(area)) {
        return TRUE;
    }
    const Canvas canvas = canvasOf(*context);
    const auto* const brush = findObjectAs<Brush>(context->state.brush);
    const auto* const pen = findObjectAs<Pen>(context->state.pen);
    if (brush != nullptr && brush->visible) {
        fillArea(canvas, area, pixelOf(*context, canvas, brush->colour));
    }
    if (pen != nullptr && pen->visible) {
        outline(canvas, area, pixelOf(*context, canvas, pen->colour));
    }
    return TRUE;
}

int FillRect(HDC dc, const RECT* area, HBRUSH brush) {
    const DeviceContext* const context = findContext(dc);
    const auto* const found = findObjectAs<Brush>(brush);
    if (context == nullptr || area == nullptr || found == nullptr) {
        return 0;
    }
    if (found->visible) {
        const Canvas canvas = canvasOf(*context);
        fillArea(canvas, *area, pixelOf(*context, canvas, found->colour));
    }
    return 1;
}

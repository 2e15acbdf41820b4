// Copies of rectangles by the three raster operations, plain and stretched.
#include "platform/gdi/canvas.h"
#include "platform/gdi/objects.h"
#include "platform/gdi/rows.h"

#include <algorithm>
#include <cstdint>
#include <functional>
#include <vector>

using namespace seam;

namespace {

using RowOperation = void (*)(DWORD* target, const DWORD* source, std::size_t count);

RowOperation rowOperation(DWORD operation) {
    switch (operation) {
    case SRCCOPY:
        return copyRow;
    case SRCAND:
        return andRow;
    case SRCPAINT:
        return orRow;
    default:
        return nullptr;
    }
}

/// How a row of the source becomes one of the target's form.
struct Conversion {
    enum class Kind { none, match, tint };
    Kind kind = Kind::none;
    DWORD first = 0;  // match: the pixel that becomes white; tint: what white becomes
    DWORD second = 0; // tint: what black becomes

    void run(DWORD* target, const DWORD* source, std::size_t count) const {
        if (kind == Kind::match) {
            matchRow(target, source, count, first);
        } else if (kind == Kind::tint) {
            tintRow(target, source, count, first, second);
        } else {
            copyRow(target, source, count);
        }
    }
};

struct End {
    const DeviceContext& context;
    Canvas canvas;
};

Conversion conversion(const End& target, const End& source) {
    using Kind = Conversion::Kind;
    if (target.canvas.monochrome == source.canvas.monochrome) {
        return {};
    }
    if (target.canvas.monochrome) {
        return {Kind::match, opaquePixel(source.context.state.background), 0};
    }
    const DWORD one = opaquePixel(target.context.state.background);
    const DWORD zero = opaquePixel(target.context.state.text);
    if (one == whitePixel && zero == blackPixel) {
        return {}; // the pixels of a monochrome bitmap as they are
    }
    return {Kind::tint, one, zero};
}

/// A copy along one direction: `length` pixels from `source` on to `target` on.
struct Span {
    std::int64_t target;
    std::int64_t source;
    std::int64_t length;

    /// Leaves what lies in both the clip and the source.
    void clip(std::int64_t low, std::int64_t high, std::int64_t sourceLength) {
        const std::int64_t cut = std::max({low - target, -source, std::int64_t{0}});
        target += cut;
        source += cut;
        length = std::min({length - cut, high - target, sourceLength - source});
    }
};

bool shareMemory(const PixelView& a, const PixelView& b) {
    const auto pixels = [](const PixelView& view) {
        return static_cast<std::ptrdiff_t>(view.stride) * view.height;
    };
    const std::less<> before;
    return before(a.bits, b.bits + pixels(b)) && before(b.bits, a.bits + pixels(a));
}

RECT areaOf(const Span& across, const Span& down) {
    return {static_cast<LONG>(across.target), static_cast<LONG>(down.target),
            static_cast<LONG>(across.target + across.length),
            static_cast<LONG>(down.target + down.length)};
}

/// Copies the clipped spans. Within one picture rows go in the order in which none is overwritten
/// before it has been read, each by way of `passing`.
void copySpans(const End& target, const End& source, const Span& across, const Span& down,
               RowOperation operate) {
    const Conversion convert = conversion(target, source);
    const bool shared = shareMemory(target.canvas.view, source.canvas.view);
    const bool direct = !shared && convert.kind == Conversion::Kind::none;
    const auto width = static_cast<std::size_t>(across.length);
    std::vector<DWORD> passing(direct ? 0 : width);
    const auto rowOf = [](const End& end, std::int64_t x, std::int64_t y) {
        return end.canvas.at(static_cast<int>(x), static_cast<int>(y));
    };
    const bool upwards = shared && rowOf(target, across.target, down.target) >
                                       rowOf(source, across.source, down.source);
    for (std::int64_t i = 0; i < down.length; ++i) {
        const std::int64_t row = upwards ? down.length - 1 - i : i;
        DWORD* const to = rowOf(target, across.target, down.target + row);
        const DWORD* const from = rowOf(source, across.source, down.source + row);
        if (direct) {
            operate(to, from, width);
        } else if (!shared && operate == copyRow) {
            convert.run(to, from, width);
        } else {
            convert.run(passing.data(), from, width);
            operate(to, passing.data(), width);
        }
    }
}

/// The bitmap that a context has, as long as it is a mosaic; else null.
Bitmap* mosaicOf(const DeviceContext& context) {
    auto* const bitmap = context.ofWindow ? nullptr : findObjectAs<Bitmap>(context.state.bitmap);
    return bitmap != nullptr && bitmap->mosaic != nullptr ? bitmap : nullptr;
}

/// Lays a whole tile on a mosaic; false if that isn't what is to be copied.
bool layTile(const DeviceContext& target, int x, int y, int width, int height,
             const DeviceContext& source, int sourceX, int sourceY) {
    Bitmap* const bitmap = mosaicOf(target);
    if (bitmap == nullptr || mosaicOf(source) != nullptr) {
        return false;
    }
    const Canvas tile = canvasOf(source);
    const bool isSmall = width <= bitmap->width / 2 && height <= bitmap->height / 2;
    return isSmall && !tile.monochrome && sourceX == 0 && sourceY == 0 &&
           width == tile.view.width && height == tile.view.height &&
           bitmap->mosaic->lay(tile.view, x, y);
}

/// Copies from a mosaic; false if it isn't whole, or if the target isn't of its form.
bool copyMosaic(const DeviceContext& target, int x, int y, int width, int height,
                const DeviceContext& source, int sourceX, int sourceY) {
    const Bitmap* const bitmap = mosaicOf(source);
    if (bitmap == nullptr || bitmap == mosaicOf(target) || !bitmap->mosaic->isWhole()) {
        return false;
    }
    const Canvas canvas = canvasOf(target);
    if (canvas.monochrome) {
        return false;
    }
    Span across{x, sourceX, width};
    Span down{y, sourceY, height};
    across.clip(canvas.clip.left, canvas.clip.right, bitmap->width);
    down.clip(canvas.clip.top, canvas.clip.bottom, bitmap->height);
    if (across.length < 1 || down.length < 1) {
        return true;
    }
    const RECT area = areaOf(across, down);
    touch(canvas, area);
    for (int row = 0; row < area.bottom - area.top; ++row) {
        bitmap->mosaic->copyRow(canvas.at(area.left, area.top + row),
                                static_cast<int>(across.source),
                                static_cast<int>(down.source) + row, area.right - area.left);
    }
    return true;
}

/// Which pixels of the source a stretched run of target pixels shows, -1 for none.
std::vector<int> stretchedPlaces(const Span& target, std::int64_t low, std::int64_t high,
                                 std::int64_t sourceExtent, std::int64_t sourceLength) {
    std::vector<int> places;
    for (std::int64_t i = std::max(low, target.target);
         i < std::min(high, target.target + target.length); ++i) {
        const std::int64_t place =
            target.source + (i - target.target) * sourceExtent / target.length;
        places.push_back(place >= 0 && place < sourceLength ? static_cast<int>(place) : -1);
    }
    return places;
}

/// Cuts off places without a pixel of the source and gives the first that has one.
std::size_t trimPlaces(std::vector<int>& places) {
    const auto isInside = [](int place) { return place >= 0; };
    places.erase(std::find_if(places.rbegin(), places.rend(), isInside).base(), places.end());
    const auto first = std::find_if(places.begin(), places.end(), isInside);
    const auto cut = static_cast<std::size_t>(first - places.begin());
    places.erase(places.begin(), first);
    return cut;
}

struct Stretch {
    std::vector<int> columns; // of the source, one a target column
    std::vector<int> rows;
    RECT area; // in the target
};

Stretch planStretch(const End& target, const End& source, const Span& across, const Span& down,
                    int sourceWidth, int sourceHeight) {
    const RECT& clip = target.canvas.clip;
    Stretch plan;
    plan.columns =
        stretchedPlaces(across, clip.left, clip.right, sourceWidth, source.canvas.view.width);
    plan.rows =
        stretchedPlaces(down, clip.top, clip.bottom, sourceHeight, source.canvas.view.height);
    const auto left = std::max<std::int64_t>(across.target, clip.left) +
                      static_cast<std::int64_t>(trimPlaces(plan.columns));
    const auto top = std::max<std::int64_t>(down.target, clip.top) +
                     static_cast<std::int64_t>(trimPlaces(plan.rows));
    plan.area = areaOf({left, 0, static_cast<std::int64_t>(plan.columns.size())},
                       {top, 0, static_cast<std::int64_t>(plan.rows.size())});
    return plan;
}

/// Gathers the whole source first: it may be the target too.
void copyStretched(const End& target, const End& source, const Stretch& plan,
                   RowOperation operate) {
    const Conversion convert = conversion(target, source);
    const std::size_t width = plan.columns.size();
    std::vector<DWORD> gathered;
    gathered.reserve(width * plan.rows.size());
    for (const int row : plan.rows) {
        for (const int column : plan.columns) {
            gathered.push_back(*source.canvas.at(column, row));
        }
    }
    std::vector<DWORD> passing(width);
    for (std::size_t i = 0; i < plan.rows.size(); ++i) {
        convert.run(passing.data(), gathered.data() + i * width, width);
        operate(target.canvas.at(plan.area.left, plan.area.top + static_cast<int>(i)),
                passing.data(), width);
    }
}

} // namespace

BOOL BitBlt(HDC target, int x, int y, int width, int height, HDC source, int sourceX, int sourceY,
            DWORD operation) {
    const DeviceContext* const to = findContext(target);
    const DeviceContext* const from = findContext(source);
    const RowOperation operate = rowOperation(operation);
    if (to == nullptr || from == nullptr || operate == nullptr) {
        return FALSE;
    }
    if (operation == SRCCOPY && (layTile(*to, x, y, width, height, *from, sourceX, sourceY) ||
                                 copyMosaic(*to, x, y, width, height, *from, sourceX, sourceY))) {
        return TRUE;
    }
    const End targetEnd{*to, canvasOf(*to)};
    const End sourceEnd{*from, canvasOf(*from)};
    const RECT& clip = targetEnd.canvas.clip;
    Span across{x, sourceX, width};
    Span down{y, sourceY, height};
    across.clip(clip.left, clip.right, sourceEnd.canvas.view.width);
    down.clip(clip.top, clip.bottom, sourceEnd.canvas.view.height);
    if (across.length > 0 && down.length > 0) {
        touch(targetEnd.canvas, areaOf(across, down));
        copySpans(targetEnd, sourceEnd, across, down, operate);
    }
    return TRUE;
}

BOOL StretchBlt(HDC target, int x, int y, int width, int height, HDC source, int sourceX,
                int sourceY, int sourceWidth, int sourceHeight, DWORD operation) {
    if (width == sourceWidth && height == sourceHeight && width > 0 && height > 0) {
        return BitBlt(target, x, y, width, height, source, sourceX, sourceY, operation);
    }
    const DeviceContext* const to = findContext(target);
    const DeviceContext* const from = findContext(source);
    const RowOperation operate = rowOperation(operation);
    if (to == nullptr || from == nullptr || operate == nullptr || width < 1 || height < 1 ||
        sourceWidth < 1 || sourceHeight < 1) {
        return FALSE;
    }
    const End targetEnd{*to, canvasOf(*to)};
    const End sourceEnd{*from, canvasOf(*from)};
    const Stretch plan = planStretch(targetEnd, sourceEnd, {x, sourceX, width},
                                     {y, sourceY, height}, sourceWidth, sourceHeight);
    if (!isEmpty(plan.area)) {
        touch(targetEnd.canvas, plan.area);
        copyStretched(targetEnd, sourceEnd, plan, operate);
    }
    return TRUE;
}

#include "platform/gdi/objects.h"

#include "platform/gdi/canvas.h"
#include "platform/gdi/context.h"
#include "platform/gdi/rows.h"
#include "platform/harness.h"

#include <array>
#include <cstdint>
#include <memory>
#include <utility>

namespace seam {

namespace {

constexpr int stockObjectCount = 14;

/// The largest bitmap by width or height, and in pixels: far above any screen, and far below what
/// would take the machine down.
constexpr int largestSide = 32767;
constexpr std::int64_t largestArea = std::int64_t{1} << 26;

/// From so many pixels on a picture may be a mosaic: from a megabyte on makePixels maps its memory,
/// which costs nothing until it is written to.
constexpr std::size_t mosaicFrom = std::size_t{1} << 18U;

struct Objects {
    HandleTable<GdiObject> table{HandleKind::gdiObject};
    std::array<HGDIOBJ, stockObjectCount> stock{};
    HGDIOBJ bitmap;
    std::size_t stockCount = 0;

    Objects();
    HGDIOBJ addStock(std::variant<Bitmap, Pen, Brush, Font> value);
};

HGDIOBJ Objects::addStock(std::variant<Bitmap, Pen, Brush, Font> value) {
    auto object = std::make_unique<GdiObject>();
    object->value = std::move(value);
    object->stock = true;
    ++stockCount;
    return HGDIOBJ{table.add(std::move(object))};
}

Objects::Objects() {
    constexpr COLORREF black = RGB(0, 0, 0);
    constexpr COLORREF white = RGB(255, 255, 255);
    constexpr COLORREF lightGrey = RGB(192, 192, 192);
    constexpr int systemFontHeight = -13;
    constexpr int bold = 700;
    stock[WHITE_BRUSH] = addStock(Brush{white});
    stock[LTGRAY_BRUSH] = addStock(Brush{lightGrey});
    stock[BLACK_BRUSH] = addStock(Brush{black});
    stock[NULL_BRUSH] = addStock(Brush{black, false});
    stock[WHITE_PEN] = addStock(Pen{white});
    stock[BLACK_PEN] = addStock(Pen{black});
    stock[NULL_PEN] = addStock(Pen{black, false});
    stock[SYSTEM_FONT] = addStock(Font(systemFontHeight, bold, false));
    static DWORD pixel = blackPixel; // never refused
    bitmap = addStock(Bitmap{1, 1, true, PixelBlock(&pixel), nullptr});
}

/// Never destroyed: fonts must not outlive the toolkit, nor be freed after it.
Objects& objects() {
    static Objects& all = *new Objects;
    return all;
}

} // namespace

HGDIOBJ addObject(std::variant<Bitmap, Pen, Brush, Font> value) {
    auto object = std::make_unique<GdiObject>();
    object->value = std::move(value);
    return HGDIOBJ{objects().table.add(std::move(object))};
}

GdiObject* findObject(HGDIOBJ handle) {
    return objects().table.find(handle.number);
}

HBITMAP defaultBitmap() {
    return HBITMAP{objects().bitmap};
}

Bitmap makeBitmap(int width, int height, bool monochrome) {
    if (width < 1 || height < 1 || width > largestSide || height > largestSide ||
        std::int64_t{width} * height > largestArea) {
        return {};
    }
    const auto count = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
    return {width, height, monochrome, makePixels(count), nullptr};
}

PixelView Bitmap::view() {
    const PixelView all{pixels.get(), width, height, width};
    if (mosaic != nullptr) {
        mosaic->writeTo(all);
        mosaic.reset();
    }
    return all;
}

void countGdiHandles(HandleCounts& counts) {
    counts.gdiObjects = objects().table.live() - objects().stockCount;
    counts.deviceContexts = liveContexts();
    counts.palettes = livePalettes();
}

Picture bitmapPicture(HBITMAP bitmap) {
    Picture picture;
    if (auto* found = findObjectAs<Bitmap>(bitmap)) {
        const DWORD meaning = found->monochrome ? 1 : 0x00FFFFFF;
        picture.width = found->width;
        picture.height = found->height;
        const auto count =
            static_cast<std::size_t>(found->width) * static_cast<std::size_t>(found->height);
        const DWORD* const pixels = found->view().bits;
        picture.pixels.assign(pixels, pixels + count);
        for (DWORD& pixel : picture.pixels) {
            pixel &= meaning;
        }
    }
    return picture;
}

} // namespace seam

using namespace seam;

BOOL DeleteObject(HGDIOBJ object) {
    const GdiObject* const found = findObject(object);
    if (found == nullptr || found->stock || found->selections > 0) {
        return FALSE;
    }
    objects().table.take(object.number);
    return TRUE;
}

HGDIOBJ GetStockObject(int index) {
    return index < 0 || index >= stockObjectCount
               ? HGDIOBJ{}
               : objects().stock.at(static_cast<std::size_t>(index));
}

HBITMAP CreateCompatibleBitmap(HDC dc, int width, int height) {
    const DeviceContext* const context = findContext(dc);
    if (context == nullptr) {
        return {};
    }
    Bitmap bitmap = makeBitmap(width, height, isMonochrome(*context));
    if (!bitmap.pixels) {
        return {};
    }
    const auto count = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
    if (count < mosaicFrom || bitmap.monochrome) {
        fillRow(bitmap.pixels.get(), count, blackPixel);
    } else {
        bitmap.mosaic = std::make_unique<Mosaic>(width, height);
    }
    return HBITMAP{addObject(std::move(bitmap))};
}

int GetObjectA(HGDIOBJ object, int size, void* record) {
    const auto* const bitmap = findObjectAs<Bitmap>(object);
    if (bitmap == nullptr || record == nullptr || size < static_cast<int>(sizeof(BITMAP))) {
        return 0;
    }
    constexpr WORD colourDepth = 32;
    BITMAP& told = *static_cast<BITMAP*>(record);
    told = {};
    told.bmWidth = bitmap->width;
    told.bmHeight = bitmap->height;
    told.bmWidthBytes = bitmap->monochrome ? (bitmap->width + 15) / 16 * 2 : bitmap->width * 4;
    told.bmPlanes = 1;
    told.bmBitsPixel = bitmap->monochrome ? 1 : colourDepth;
    return sizeof(BITMAP);
}

HPEN CreatePen(int style, int width, COLORREF colour) {
    return style == PS_SOLID && width == 1 ? HPEN{addObject(Pen{colour})} : HPEN{};
}

HBRUSH CreateSolidBrush(COLORREF colour) {
    return HBRUSH{addObject(Brush{colour})};
}

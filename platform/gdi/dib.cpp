// Bitmaps from the bytes of device-independent ones.
#include "platform/gdi/context.h"
#include "platform/gdi/objects.h"
#include "platform/gdi/rows.h"
#include "platform/kernel.h"

#include <array>
#include <cstdint>
#include <cstring>

using namespace seam;

namespace {

constexpr WORD trueColourBits = 24;
constexpr DWORD bytesPerColour = 4;

bool isDepth(WORD bits) {
    return bits == 1 || bits == 4 || bits == 8 || bits == trueColourBits;
}

/// Whether a colour table of that many bits can have so many colours.
bool isReadable(const BITMAPINFOHEADER& info) {
    constexpr DWORD mostColours = 256;
    return info.biSize == sizeof(BITMAPINFOHEADER) && isDepth(info.biBitCount) &&
           info.biCompression == 0 && info.biClrUsed <= mostColours;
}

DWORD colourCount(const BITMAPINFOHEADER& info) {
    if (info.biClrUsed != 0 || info.biBitCount == trueColourBits) {
        return info.biClrUsed;
    }
    return DWORD{1} << info.biBitCount;
}

DWORD pixelFromBytes(const BYTE* colour) {
    return 0xFF000000U | (DWORD{colour[2]} << 16U) | (DWORD{colour[1]} << 8U) | colour[0];
}

/// Black where the table has no colour.
using ColourTable = std::array<DWORD, 256>;

ColourTable readColours(const BITMAPINFOHEADER& info) {
    ColourTable colours;
    colours.fill(blackPixel);
    const auto* bytes = reinterpret_cast<const BYTE*>(&info) + sizeof(BITMAPINFOHEADER);
    for (DWORD i = 0; i < colourCount(info); ++i) {
        colours.at(i) = pixelFromBytes(bytes + static_cast<std::size_t>(i) * bytesPerColour);
    }
    return colours;
}

/// Bytes of a row, filled up to four.
std::size_t rowBytes(std::int64_t width, WORD bits) {
    return static_cast<std::size_t>((width * bits + 31) / 32 * 4);
}

void readRow(DWORD* target, const BYTE* source, int width, WORD bits, const ColourTable& colours) {
    for (int x = 0; x < width; ++x) {
        const auto column = static_cast<unsigned>(x);
        if (bits == trueColourBits) {
            target[x] = pixelFromBytes(source + std::size_t{3} * column);
            continue;
        }
        const unsigned bit = column * bits;
        const unsigned shift = 8U - bits - bit % 8U;
        const unsigned mask = (1U << bits) - 1U;
        target[x] = colours.at((unsigned{source[bit / 8U]} >> shift) & mask);
    }
}

/// A negative height says that the rows go from the top down.
HBITMAP readBitmap(const BITMAPINFOHEADER& header, const BITMAPINFOHEADER& info,
                   const BYTE* pixels) {
    const std::int64_t rows = header.biHeight;
    const std::int64_t height = rows < 0 ? -rows : rows;
    if (!isReadable(info) || height > INT32_MAX) {
        return {};
    }
    Bitmap bitmap = makeBitmap(header.biWidth, static_cast<int>(height), false);
    if (!bitmap.pixels) {
        return {};
    }
    const ColourTable colours = readColours(info);
    const std::size_t stride = rowBytes(bitmap.width, info.biBitCount);
    for (int y = 0; y < bitmap.height; ++y) {
        const int row = rows < 0 ? y : bitmap.height - 1 - y;
        readRow(bitmap.pixels.get() + static_cast<std::ptrdiff_t>(y) * bitmap.width,
                pixels + static_cast<std::size_t>(row) * stride, bitmap.width, info.biBitCount,
                colours);
    }
    return HBITMAP{addObject(std::move(bitmap))};
}

/// Reads a bitmap from `size` bytes: head, colours, pixels; null if they don't hold all of it.
HBITMAP readPackedBitmap(const BYTE* bytes, std::size_t size) {
    if (bytes == nullptr || size < sizeof(BITMAPINFOHEADER)) {
        return {};
    }
    const auto* const info = reinterpret_cast<const BITMAPINFOHEADER*>(bytes);
    if (!isReadable(*info) || info->biWidth < 1) {
        return {};
    }
    const std::size_t start =
        sizeof(BITMAPINFOHEADER) + std::size_t{colourCount(*info)} * bytesPerColour;
    const std::int64_t rows = info->biHeight;
    const auto height = static_cast<std::size_t>(rows < 0 ? -rows : rows);
    if (size < start || (size - start) / rowBytes(info->biWidth, info->biBitCount) < height) {
        return {};
    }
    return readBitmap(*info, *info, bytes + start);
}

} // namespace

HBITMAP CreateDIBitmap(HDC dc, const BITMAPINFOHEADER* header, DWORD init, const void* pixels,
                       const BITMAPINFOHEADER* info, UINT usage) {
    if (findContext(dc) == nullptr || header == nullptr || info == nullptr || pixels == nullptr ||
        init != CBM_INIT || usage != DIB_RGB_COLORS) {
        return {};
    }
    return readBitmap(*header, *info, static_cast<const BYTE*>(pixels));
}

HBITMAP LoadBitmapA(HINSTANCE instance, ResourceName name) {
    const HRSRC resource = FindResourceA(instance, name, RT_BITMAP);
    if (!resource) {
        return {};
    }
    const HGLOBAL bytes = LoadResource(instance, resource);
    const HBITMAP bitmap = readPackedBitmap(static_cast<const BYTE*>(LockResource(bytes)),
                                            SizeofResource(instance, resource));
    FreeResource(bytes);
    return bitmap;
}

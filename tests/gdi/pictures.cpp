#include "tests/gdi/pictures.h"

#include <algorithm>
#include <climits>
#include <string_view>

namespace test {

namespace {

constexpr std::string_view names = ".WxcRGBYM01";
constexpr DWORD colours[] = {0x000000, 0xFFFFFF, 0x808080, 0xC0C0C0, 0xFF0000, 0x00FF00,
                             0x0000FF, 0xFFFF00, 0xFF00FF, 0x000000, 0xFFFFFF};

char nameOf(DWORD pixel) {
    const auto* const found = std::find(std::begin(colours), std::end(colours), pixel & 0xFFFFFFU);
    return found == std::end(colours) ? '?' : names[static_cast<std::size_t>(found - colours)];
}

template <class Name>
Rows rowsOf(int width, int height, const DWORD* pixels, Name name) {
    Rows rows(static_cast<std::size_t>(height));
    for (std::string& row : rows) {
        for (int x = 0; x < width; ++x) {
            row += name(*pixels++);
        }
    }
    return rows;
}

int widthOf(const Rows& rows) {
    return static_cast<int>(rows.front().size());
}

int heightOf(const Rows& rows) {
    return static_cast<int>(rows.size());
}

} // namespace

Rows plain(int width, int height, char colour) {
    return Rows(static_cast<std::size_t>(height),
                std::string(static_cast<std::size_t>(width), colour));
}

Rows textOf(HBITMAP bitmap) {
    BITMAP info{};
    GetObjectA(bitmap, sizeof(info), &info);
    const seam::Picture picture = seam::bitmapPicture(bitmap);
    return rowsOf(picture.width, picture.height, picture.pixels.data(), [&](DWORD pixel) {
        return info.bmBitsPixel == 1 ? static_cast<char>('0' + pixel) : nameOf(pixel);
    });
}

TestSurface::TestSurface(const Rows& rows, const RECT& clip)
    : dc(seam::makeSurfaceContext(*this, clip)), width_(widthOf(rows)), height_(heightOf(rows)) {
    for (const std::string& row : rows) {
        for (const char name : row) {
            pixels_.push_back(0xFF000000U | colours[names.find(name)]);
        }
    }
}

TestSurface::~TestSurface() {
    DeleteDC(dc);
}

seam::PixelView TestSurface::pixels() {
    return {pixels_.data(), width_, height_, width_};
}

void TestSurface::touch(const RECT& area) {
    touched.push_back(area);
    before.push_back(text());
}

Rows TestSurface::text() const {
    return rowsOf(width_, height_, pixels_.data(), nameOf);
}

HBITMAP makeBitmap(const Rows& rows) {
    const TestSurface picture(rows);
    HDC dc = CreateCompatibleDC(nullptr);
    const bool monochrome = rows[0][0] == '0' || rows[0][0] == '1';
    HBITMAP bitmap =
        CreateCompatibleBitmap(monochrome ? dc : picture.dc, widthOf(rows), heightOf(rows));
    SelectObject(dc, bitmap);
    BitBlt(dc, 0, 0, widthOf(rows), heightOf(rows), picture.dc, 0, 0, SRCCOPY);
    DeleteDC(dc);
    return bitmap;
}

Memory::Memory(const Rows& rows) : dc(CreateCompatibleDC(nullptr)), bitmap(makeBitmap(rows)) {
    SelectObject(dc, bitmap);
}

Memory::~Memory() {
    DeleteDC(dc);
    DeleteObject(bitmap);
}

RECT boundsOf(const Rows& rows, char colour) {
    RECT bounds{INT_MAX, INT_MAX, 0, 0};
    for (int y = 0; y < heightOf(rows); ++y) {
        const std::string& row = rows[static_cast<std::size_t>(y)];
        if (row.find(colour) != std::string::npos) {
            bounds = {std::min(bounds.left, static_cast<LONG>(row.find(colour))),
                      std::min(bounds.top, y),
                      std::max(bounds.right, static_cast<LONG>(row.rfind(colour)) + 1), y + 1};
        }
    }
    return bounds.right == 0 ? RECT{0, 0, 0, 0} : bounds;
}

seam::HandleCounts liveObjects() {
    seam::HandleCounts counts;
    seam::countGdiHandles(counts);
    return counts;
}

} // namespace test

bool operator==(const RECT& a, const RECT& b) {
    return a.left == b.left && a.top == b.top && a.right == b.right && a.bottom == b.bottom;
}

void PrintTo(const RECT& area, std::ostream* out) {
    *out << area.left << ',' << area.top << " to " << area.right << ',' << area.bottom;
}

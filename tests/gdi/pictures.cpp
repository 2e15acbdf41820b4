#include "tests/gdi/pictures.h"

#include <algorithm>
#include <ostream>
#include <utility>

namespace test {

namespace {

constexpr DWORD colourBits = 0x00FFFFFF;

struct Colour {
    char name;
    DWORD pixel;
};

constexpr Colour colours[] = {{'.', 0x000000}, {'W', 0xFFFFFF}, {'x', 0x808080},
                              {'c', 0xC0C0C0}, {'R', 0xFF0000}, {'G', 0x00FF00},
                              {'B', 0x0000FF}, {'Y', 0xFFFF00}, {'M', 0xFF00FF}};

DWORD pixelOf(char name) {
    const auto* const found = std::find_if(std::begin(colours), std::end(colours),
                                           [name](const Colour& c) { return c.name == name; });
    return found == std::end(colours) ? 0x123456 : found->pixel;
}

char nameOf(DWORD pixel) {
    const auto* const found = std::find_if(std::begin(colours), std::end(colours),
                                           [pixel](const Colour& c) { return c.pixel == pixel; });
    return found == std::end(colours) ? '?' : found->name;
}

Rows rowsOf(int width, int height, const DWORD* pixels) {
    Rows rows;
    for (int y = 0; y < height; ++y) {
        std::string& row = rows.emplace_back();
        for (int x = 0; x < width; ++x) {
            row += nameOf(*pixels++ & colourBits);
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

COLORREF colourOf(char name) {
    const DWORD pixel = pixelOf(name);
    return RGB(static_cast<int>(pixel >> 16U), static_cast<int>((pixel >> 8U) & 0xFFU),
               static_cast<int>(pixel & 0xFFU));
}

Rows textOf(const seam::Picture& picture, bool monochrome) {
    Rows rows = rowsOf(picture.width, picture.height, picture.pixels.data());
    if (monochrome) {
        for (std::size_t i = 0; i < picture.pixels.size(); ++i) {
            const auto width = static_cast<std::size_t>(picture.width);
            rows[i / width][i % width] = static_cast<char>('0' + picture.pixels[i]);
        }
    }
    return rows;
}

Rows textOf(HBITMAP bitmap) {
    BITMAP info{};
    GetObjectA(bitmap, sizeof(info), &info);
    return textOf(seam::bitmapPicture(bitmap), info.bmBitsPixel == 1);
}

TestSurface::TestSurface(const Rows& rows) : width_(widthOf(rows)), height_(heightOf(rows)) {
    for (const std::string& row : rows) {
        for (const char name : row) {
            pixels_.push_back(pixelOf(name)); // the top byte means nothing, here it is 0
        }
    }
}

seam::PixelView TestSurface::pixels() {
    return {pixels_.data(), width_, height_, width_};
}

void TestSurface::touch(const RECT& area) {
    touched.push_back(area);
    if (shown_.empty() || shown_.back() != text()) {
        shown_.push_back(text());
    }
}

Rows TestSurface::text() const {
    return rowsOf(width_, height_, pixels_.data());
}

std::vector<Rows> TestSurface::shown() const {
    std::vector<Rows> all = shown_;
    if (all.empty() || all.back() != text()) {
        all.push_back(text());
    }
    return all;
}

HBITMAP makeBitmap(const Rows& rows) {
    TestSurface display({"."});
    HDC compatible = seam::makeSurfaceContext(display, {0, 0, 1, 1});
    HDC dc = CreateCompatibleDC(compatible);
    HBITMAP bitmap = CreateCompatibleBitmap(compatible, widthOf(rows), heightOf(rows));
    const HGDIOBJ before = SelectObject(dc, bitmap);
    for (int y = 0; y < heightOf(rows); ++y) {
        for (int x = 0; x < widthOf(rows); ++x) {
            const char name = rows[static_cast<std::size_t>(y)][static_cast<std::size_t>(x)];
            HBRUSH brush = CreateSolidBrush(colourOf(name));
            const RECT pixel{x, y, x + 1, y + 1};
            FillRect(dc, &pixel, brush);
            DeleteObject(brush);
        }
    }
    SelectObject(dc, before);
    DeleteDC(dc);
    DeleteDC(compatible);
    return bitmap;
}

Memory::Memory(const Rows& rows)
    : dc(CreateCompatibleDC(nullptr)), bitmap(makeBitmap(rows)), before_(SelectObject(dc, bitmap)) {
}

Memory::Memory(int width, int height, bool monochrome)
    : dc(CreateCompatibleDC(nullptr)),
      bitmap(monochrome ? CreateCompatibleBitmap(dc, width, height)
                        : makeBitmap(Rows(static_cast<std::size_t>(height),
                                          std::string(static_cast<std::size_t>(width), '.')))),
      before_(SelectObject(dc, bitmap)) {}

Memory::~Memory() {
    SelectObject(dc, before_);
    DeleteDC(dc);
    DeleteObject(bitmap);
}

Rows Memory::text() const {
    return textOf(bitmap);
}

RECT boundsOf(const Rows& rows, char colour) {
    RECT bounds{0, 0, 0, 0};
    bool first = true;
    for (int y = 0; y < heightOf(rows); ++y) {
        for (int x = 0; x < widthOf(rows); ++x) {
            if (rows[static_cast<std::size_t>(y)][static_cast<std::size_t>(x)] != colour) {
                continue;
            }
            const RECT pixel{x, y, x + 1, y + 1};
            bounds = first
                         ? pixel
                         : RECT{std::min(bounds.left, pixel.left), std::min(bounds.top, pixel.top),
                                std::max(bounds.right, pixel.right),
                                std::max(bounds.bottom, pixel.bottom)};
            first = false;
        }
    }
    return bounds;
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
    *out << '(' << area.left << ", " << area.top << ", " << area.right << ", " << area.bottom
         << ')';
}

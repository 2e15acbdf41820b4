// Pictures as text: a character a pixel.
//
// '.' black, 'W' white, 'x' dark grey, 'c' light grey, 'R' red, 'G' green, 'B' blue, 'Y' yellow,
// 'M' magenta; '?' stands for any other colour. Pixels of a monochrome bitmap are '0' and '1'.
#pragma once

#include "platform/gdi.h"
#include "platform/gdi/surface.h"
#include "platform/harness.h"

#include <ostream>
#include <string>
#include <vector>

namespace test {

using Rows = std::vector<std::string>;

/// A picture of one colour.
Rows plain(int width, int height, char colour);

Rows textOf(HBITMAP bitmap);

/// A stage in memory with a context, that notes what it is told.
class TestSurface : public seam::Surface {
  public:
    explicit TestSurface(const Rows& rows, const RECT& clip = {0, 0, 999, 999});
    TestSurface(const TestSurface&) = delete;
    TestSurface& operator=(const TestSurface&) = delete;
    ~TestSurface() override;

    seam::PixelView pixels() override;
    void touch(const RECT& area) override;
    Rows text() const;

    std::vector<RECT> touched;
    std::vector<Rows> before; // the picture before each change
    HDC dc;

  private:
    int width_;
    int height_;
    std::vector<DWORD> pixels_;
};

/// A context with a bitmap of its own.
class Memory {
  public:
    explicit Memory(const Rows& rows);
    Memory(const Memory&) = delete;
    Memory& operator=(const Memory&) = delete;
    ~Memory();

    Rows text() const {
        return textOf(bitmap);
    }

    HDC dc;
    HBITMAP bitmap;
};

/// A bitmap with the picture, of the display's form or monochrome.
HBITMAP makeBitmap(const Rows& rows);

/// Bounds of the pixels of that colour, {0, 0, 0, 0} if there are none.
RECT boundsOf(const Rows& rows, char colour);

/// All objects of the seam that live now.
seam::HandleCounts liveObjects();

} // namespace test

bool operator==(const RECT& a, const RECT& b);
void PrintTo(const RECT& area, std::ostream* out);

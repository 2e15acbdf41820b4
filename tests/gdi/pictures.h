// Pictures as text: a character a pixel.
//
// '.' black, 'W' white, 'x' dark grey, 'c' light grey, 'R' red, 'G' green, 'B' blue, 'Y' yellow,
// 'M' magenta; '?' stands for any other colour. Pixels of a monochrome bitmap are '0' and '1'.
#pragma once

#include "platform/gdi.h"
#include "platform/gdi/surface.h"
#include "platform/harness.h"

#include <functional>
#include <string>
#include <vector>

namespace test {

using Rows = std::vector<std::string>;

COLORREF colourOf(char name);

Rows textOf(const seam::Picture& picture, bool monochrome = false);
Rows textOf(HBITMAP bitmap);

/// A stage in memory that notes what it is told.
class TestSurface : public seam::Surface {
  public:
    explicit TestSurface(const Rows& rows);

    seam::PixelView pixels() override;
    void touch(const RECT& area) override;

    Rows text() const;

    /// What it has shown: the picture before each change, without repetitions, and that of now.
    std::vector<Rows> shown() const;

    std::vector<RECT> touched;

  private:
    int width_;
    int height_;
    std::vector<DWORD> pixels_;
    std::vector<Rows> shown_;
};

/// A context with a bitmap of its own. Both go at the end of the test.
class Memory {
  public:
    /// A colour bitmap with the picture.
    explicit Memory(const Rows& rows);

    /// A black one of the size, colour or monochrome.
    Memory(int width, int height, bool monochrome);

    Memory(const Memory&) = delete;
    Memory& operator=(const Memory&) = delete;
    ~Memory();

    Rows text() const;

    HDC dc;
    HBITMAP bitmap;

  private:
    HGDIOBJ before_;
};

/// A bitmap of the display's form with the picture.
HBITMAP makeBitmap(const Rows& rows);

/// Bounds of the pixels of that colour, {0, 0, 0, 0} if there are none.
RECT boundsOf(const Rows& rows, char colour);

/// All objects of the seam that live now.
seam::HandleCounts liveObjects();

} // namespace test

bool operator==(const RECT& a, const RECT& b);
void PrintTo(const RECT& area, std::ostream* out);

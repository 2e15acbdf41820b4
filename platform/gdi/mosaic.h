// A large picture that is one small one over and over: eight megabytes of backdrop whose memory
// nobody has to touch.
#pragma once

#include "platform/gdi/pixel_block.h"
#include "platform/gdi/surface.h"

namespace seam {

/// Tiles are laid edge to edge from the upper left corner on, row by row, each of them whole; what
/// goes beyond the right and the lower edge is cut off. What isn't covered is black.
class Mosaic {
  public:
    Mosaic(int width, int height) : width_(width), height_(height) {}

    /// Lays a tile. False if that isn't the next place, if it isn't the tile of all the others, or
    /// if there is no memory: then nothing has changed.
    bool lay(const PixelView& tile, int x, int y);

    /// Whether tiles cover all of it.
    bool isWhole() const {
        return nextY_ >= height_;
    }

    /// Copies `count` pixels of the row y from the column x on. Only while it is whole.
    void copyRow(DWORD* target, int x, int y, int count) const;

    /// Puts it on a picture of its size.
    void writeTo(const PixelView& picture) const;

  private:
    bool keep(const PixelView& tile);
    bool isKept(const PixelView& tile) const;
    int coveredWidth(int y) const;

    int width_;
    int height_;
    PixelBlock tile_;
    int tileWidth_ = 0;
    int tileHeight_ = 0;
    int nextX_ = 0;
    int nextY_ = 0;
};

} // namespace seam

#include "platform/gdi/mosaic.h"

#include "platform/gdi/rows.h"

#include <algorithm>
#include <cstddef>

namespace seam {

static const DWORD* rowOf(const PixelView& view, int y) {
    return view.bits + static_cast<std::ptrdiff_t>(y) * view.stride;
}

bool Mosaic::lay(const PixelView& tile, int x, int y) {
    if (x != nextX_ || y != nextY_ || !(tile_ ? isKept(tile) : keep(tile))) {
        return false;
    }
    nextX_ += tileWidth_;
    if (nextX_ >= width_) {
        nextX_ = 0;
        nextY_ += tileHeight_;
    }
    return true;
}

bool Mosaic::keep(const PixelView& tile) {
    const auto width = static_cast<std::size_t>(tile.width);
    tile_ = makePixels(width * static_cast<std::size_t>(tile.height));
    if (!tile_) {
        return false;
    }
    tileWidth_ = tile.width;
    tileHeight_ = tile.height;
    for (int y = 0; y < tile.height; ++y) {
        seam::copyRow(&tile_[static_cast<std::size_t>(y) * width], rowOf(tile, y), width);
    }
    return true;
}

bool Mosaic::isKept(const PixelView& tile) const {
    if (tile.width != tileWidth_ || tile.height != tileHeight_) {
        return false;
    }
    const PixelView kept{tile_.get(), tileWidth_, tileHeight_, tileWidth_};
    for (int y = 0; y < tileHeight_; ++y) {
        if (!std::equal(rowOf(tile, y), rowOf(tile, y) + tileWidth_, rowOf(kept, y))) {
            return false;
        }
    }
    return true;
}

void Mosaic::copyRow(DWORD* target, int x, int y, int count) const {
    while (count > 0) {
        const int column = x % tileWidth_;
        const int run = std::min(count, tileWidth_ - column);
        const auto place = static_cast<std::size_t>(y % tileHeight_ * tileWidth_ + column);
        seam::copyRow(target, &tile_[place], static_cast<std::size_t>(run));
        target += run;
        x += run;
        count -= run;
    }
}

/// How much of a row has been laid.
int Mosaic::coveredWidth(int y) const {
    if (y < nextY_) {
        return width_;
    }
    return y < nextY_ + tileHeight_ ? nextX_ : 0;
}

void Mosaic::writeTo(const PixelView& picture) const {
    for (int y = 0; y < height_; ++y) {
        DWORD* const row = picture.bits + static_cast<std::ptrdiff_t>(y) * picture.stride;
        const int covered = coveredWidth(y);
        copyRow(row, 0, y, covered);
        fillRow(row + covered, static_cast<std::size_t>(width_ - covered), blackPixel);
    }
}

} // namespace seam

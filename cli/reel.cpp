#include "cli/reel.h"

#include <algorithm>
#include <utility>

static constexpr DWORD colourOf = 0x00FFFFFF; // the top byte of a pixel means nothing

Reel::Reel(std::function<void(const FilmPicture&)> sink) : sink_(std::move(sink)) {}

void Reel::draw(std::int64_t moment, const RECT& drawn, const seam::PixelView& stage) {
    if (drawn_.empty()) {
        begin(stage);
    } else if (moment > moment_) {
        gather();
    }
    moment_ = moment;
    const RECT area{std::max<LONG>(drawn.left, 0), std::max<LONG>(drawn.top, 0),
                    std::min<LONG>(drawn.right, width_), std::min<LONG>(drawn.bottom, height_)};
    for (LONG y = area.top; y < area.bottom; ++y) {
        const DWORD* from = stage.bits + static_cast<std::ptrdiff_t>(y) * stage.stride;
        DWORD* to = drawn_.data() + static_cast<std::ptrdiff_t>(y) * width_;
        for (LONG x = area.left; x < area.right; ++x) {
            to[x] = from[x] & colourOf;
        }
    }
    area_ = area_.right == 0
                ? area
                : RECT{std::min(area_.left, area.left), std::min(area_.top, area.top),
                       std::max(area_.right, area.right), std::max(area_.bottom, area.bottom)};
}

void Reel::begin(const seam::PixelView& stage) {
    width_ = stage.width;
    height_ = stage.height;
    drawn_.resize(static_cast<std::size_t>(width_) * static_cast<std::size_t>(height_));
}

/// All that belongs to the moment of the last drawing is there: if it makes a picture, the one that
/// stood is over.
void Reel::gather() {
    if (picture_.empty()) {
        picture_ = drawn_;
        area_ = {0, 0, width_, height_};
    } else {
        crop();
        if (area_.right == 0) {
            return;
        }
        handOver(moment_);
    }
    const auto width = area_.right - area_.left;
    for (LONG y = area_.top; y < area_.bottom; ++y) {
        const auto at = static_cast<std::ptrdiff_t>(y) * width_ + area_.left;
        std::copy_n(drawn_.begin() + at, width, picture_.begin() + at);
    }
    from_ = moment_;
    changed_ = std::exchange(area_, RECT{});
}

void Reel::handOver(std::int64_t to) {
    sink_({from_, to, changed_, {picture_.data(), width_, height_, width_}});
}

bool Reel::rowDiffers(LONG y, LONG left, LONG right) const {
    const auto at = static_cast<std::ptrdiff_t>(y) * width_;
    return !std::equal(drawn_.begin() + at + left, drawn_.begin() + at + right,
                       picture_.begin() + at + left);
}

/// Holds the area to where the drawn differs from the picture; all 0 if it doesn't.
void Reel::crop() {
    RECT found{area_.right, 0, 0, 0};
    while (area_.top < area_.bottom && !rowDiffers(area_.top, area_.left, area_.right)) {
        ++area_.top;
    }
    while (area_.top < area_.bottom && !rowDiffers(area_.bottom - 1, area_.left, area_.right)) {
        --area_.bottom;
    }
    for (LONG y = area_.top; y < area_.bottom; ++y) {
        const auto at = static_cast<std::ptrdiff_t>(y) * width_;
        const DWORD* drawn = drawn_.data() + at;
        const DWORD* picture = picture_.data() + at;
        LONG left = area_.left;
        while (left < found.left && drawn[left] == picture[left]) {
            ++left;
        }
        LONG right = area_.right;
        while (right > std::max(found.right, left) && drawn[right - 1] == picture[right - 1]) {
            --right;
        }
        found.left = std::min(found.left, left);
        found.right = std::max(found.right, right);
    }
    area_ =
        area_.top < area_.bottom ? RECT{found.left, area_.top, found.right, area_.bottom} : RECT{};
}

void Reel::end(std::int64_t moment) {
    if (drawn_.empty()) {
        return;
    }
    gather();
    handOver(moment);
}

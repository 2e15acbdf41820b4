#include "cli/colours.h"

Colours::Colours() {
    keys_.fill(empty);
}

std::size_t Colours::slotOf(DWORD colour) const {
    constexpr DWORD spread = 2654435769; // odd, and without a pattern in its bits
    constexpr unsigned surplusBits = 32 - 11;
    static_assert(slots == 1U << (32 - surplusBits));
    std::size_t slot = (colour * spread) >> surplusBits;
    while (keys_[slot] != colour && keys_[slot] != empty) {
        slot = (slot + 1) % slots;
    }
    return slot;
}

void Colours::addOne(DWORD colour) {
    const std::size_t slot = slotOf(colour);
    if (keys_[slot] == colour || tooMany_) {
        return;
    }
    if (list_.size() == most) {
        tooMany_ = true;
        return;
    }
    keys_[slot] = colour;
    numbers_[slot] = static_cast<std::uint8_t>(list_.size());
    list_.push_back(colour);
}

bool Colours::add(const seam::PixelView& picture, const RECT& area) {
    DWORD last = empty; // most pixels have the colour of the one before
    for (LONG y = area.top; y < area.bottom && !tooMany_; ++y) {
        const DWORD* row = picture.bits + static_cast<std::ptrdiff_t>(y) * picture.stride;
        for (LONG x = area.left; x < area.right; ++x) {
            if (row[x] != last) {
                last = row[x];
                addOne(last);
            }
        }
    }
    return !tooMany_;
}

void Colours::numbersOf(const DWORD* pixels, std::size_t count, std::uint8_t* numbers) const {
    DWORD last = empty;
    std::uint8_t number = 0;
    for (std::size_t i = 0; i < count; ++i) {
        if (pixels[i] != last) {
            last = pixels[i];
            const std::size_t slot = slotOf(last);
            number = keys_[slot] == last ? numbers_[slot] : std::uint8_t{0};
        }
        numbers[i] = number;
    }
}

// The colours of a film, numbered in the order in which they came up.
#pragma once

#include "platform/gdi/surface.h"

#include <array>
#include <cstdint>
#include <vector>

class Colours {
  public:
    static constexpr std::size_t most = 256;

    Colours();

    /// Takes in the colours of an area of the picture, pixels 0x00rrggbb; false, and from then on,
    /// if there are more than `most`.
    bool add(const seam::PixelView& picture, const RECT& area);

    /// The numbers of the colours of `count` pixels; 0 for one that never came up.
    void numbersOf(const DWORD* pixels, std::size_t count, std::uint8_t* numbers) const;

    const std::vector<DWORD>& list() const {
        return list_;
    }

    bool tooMany() const {
        return tooMany_;
    }

  private:
    static constexpr std::size_t slots = 2048;
    static constexpr DWORD empty = 0xFFFFFFFF;

    /// The slot of the colour, or the empty one where it would stand.
    std::size_t slotOf(DWORD colour) const;
    void addOne(DWORD colour);

    std::vector<DWORD> list_;
    std::array<DWORD, slots> keys_;
    std::array<std::uint8_t, slots> numbers_{};
    bool tooMany_ = false;
};

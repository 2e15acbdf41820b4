#include "platform/gdi/pixel_block.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <utility>

namespace seam {

namespace {

struct SpareBlock {
    DWORD* pixels = nullptr;
    std::size_t count = 0;
};

/// Together they hold at most half a megabyte.
constexpr std::size_t largestSpare = 32768;

/// Free blocks; written by makePixels and PixelRelease only.
constinit std::array<SpareBlock, 4> spares{};

SpareBlock* spareOf(std::size_t count) {
    auto* const found =
        std::find_if(spares.begin(), spares.end(), [count](const SpareBlock& spare) {
            return spare.pixels != nullptr && spare.count == count;
        });
    return found == spares.end() ? nullptr : found;
}

} // namespace

void PixelRelease::operator()(DWORD* pixels) const {
    static constinit std::size_t nextVictim = 0;
    if (count > largestSpare) {
        std::free(pixels);
        return;
    }
    auto* place = std::find_if(spares.begin(), spares.end(),
                               [](const SpareBlock& spare) { return spare.pixels == nullptr; });
    if (place == spares.end()) {
        place = &spares.at(nextVictim);
        nextVictim = (nextVictim + 1) % spares.size();
        std::free(place->pixels);
    }
    *place = {pixels, count};
}

PixelBlock makePixels(std::size_t count) {
    if (SpareBlock* spare = spareOf(count)) {
        return {std::exchange(spare->pixels, nullptr), PixelRelease{count}};
    }
    return {static_cast<DWORD*>(std::malloc(count * sizeof(DWORD))), PixelRelease{count}};
}

} // namespace seam

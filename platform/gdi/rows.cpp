#include "platform/gdi/rows.h"

#include <cstring>

namespace seam {

namespace {

constexpr DWORD colourBits = 0x00FFFFFF;

/// With the scale known to the compiler, which then needs no inner loop.
template <std::size_t scale>
void widen(DWORD* __restrict target, const DWORD* __restrict source, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
        for (std::size_t j = 0; j < scale; ++j) {
            target[i * scale + j] = source[i];
        }
    }
}

} // namespace

void fillRow(DWORD* target, std::size_t count, DWORD pixel) {
    for (std::size_t i = 0; i < count; ++i) {
        target[i] = pixel;
    }
}

void copyRow(DWORD* target, const DWORD* source, std::size_t count) {
    std::memcpy(target, source, count * sizeof(DWORD));
}

void andRow(DWORD* __restrict target, const DWORD* __restrict source, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
        target[i] &= source[i];
    }
}

void orRow(DWORD* __restrict target, const DWORD* __restrict source, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
        target[i] |= source[i];
    }
}

void matchRow(DWORD* __restrict target, const DWORD* __restrict source, std::size_t count,
              DWORD pixel) {
    for (std::size_t i = 0; i < count; ++i) {
        target[i] = ((source[i] ^ pixel) & colourBits) == 0 ? whitePixel : blackPixel;
    }
}

void widenRow(DWORD* target, const DWORD* source, std::size_t count, std::size_t scale) {
    switch (scale) {
    case 2:
        return widen<2>(target, source, count);
    case 3:
        return widen<3>(target, source, count);
    default:
        for (std::size_t i = 0; i < count; ++i) {
            fillRow(target + i * scale, scale, source[i]);
        }
    }
}

void tintRow(DWORD* __restrict target, const DWORD* __restrict source, std::size_t count, DWORD one,
             DWORD zero) {
    for (std::size_t i = 0; i < count; ++i) {
        target[i] = (source[i] & one) | (~source[i] & zero) | blackPixel;
    }
}

} // namespace seam

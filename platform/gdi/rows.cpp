#include "platform/gdi/rows.h"

#include <cstring>

namespace seam {

namespace {

constexpr DWORD colourBits = 0x00FFFFFF;

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

void tintRow(DWORD* __restrict target, const DWORD* __restrict source, std::size_t count, DWORD one,
             DWORD zero) {
    for (std::size_t i = 0; i < count; ++i) {
        target[i] = (source[i] & one) | (~source[i] & zero) | blackPixel;
    }
}

} // namespace seam

// The loops over rows of pixels that all drawing comes down to. Source and target don't overlap.
#pragma once

#include "platform/types.h"

#include <cstddef>

namespace seam {

/// Pixels of bitmaps are opaque, 0xFFrrggbb; in a monochrome bitmap they are black or white, for 0
/// and 1.
constexpr DWORD blackPixel = 0xFF000000;
constexpr DWORD whitePixel = 0xFFFFFFFF;

void fillRow(DWORD* target, std::size_t count, DWORD pixel);
void copyRow(DWORD* target, const DWORD* source, std::size_t count);
void andRow(DWORD* target, const DWORD* source, std::size_t count);
void orRow(DWORD* target, const DWORD* source, std::size_t count);

/// White where the source has the colour of `pixel`, black elsewhere.
void matchRow(DWORD* target, const DWORD* source, std::size_t count, DWORD pixel);

/// Each pixel of the source `scale` times, which is at least 1: `count * scale` pixels.
void widenRow(DWORD* target, const DWORD* source, std::size_t count, std::size_t scale);

/// From a monochrome row: `one` where it is white, `zero` where it is black.
void tintRow(DWORD* target, const DWORD* source, std::size_t count, DWORD one, DWORD zero);

} // namespace seam

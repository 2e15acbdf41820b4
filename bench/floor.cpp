#include "bench/floor.h"

static DWORD* RowOf(const seam::PixelView& view, int x, int y) {
    return view.bits + static_cast<std::ptrdiff_t>(y) * view.stride + x;
}

void RestorePlain(const seam::PixelView& view, int x, int y, const DWORD* picture, int size) {
    for (int row = 0; row < size; ++row) {
        DWORD* __restrict target = RowOf(view, x, y + row);
        const DWORD* __restrict source = picture + static_cast<std::ptrdiff_t>(row) * size;
        for (int i = 0; i < size; ++i) {
            target[i] = source[i];
        }
    }
}

void CompositePlain(const seam::PixelView& view, int x, int y, const DWORD* picture, int size) {
    constexpr DWORD colourBits = 0x00FFFFFF;
    for (int row = 0; row < size; ++row) {
        DWORD* __restrict target = RowOf(view, x, y + row);
        const DWORD* __restrict source = picture + static_cast<std::ptrdiff_t>(row) * size;
        for (int i = 0; i < size; ++i) {
            target[i] = (source[i] & colourBits) == 0 ? target[i] : source[i];
        }
    }
}

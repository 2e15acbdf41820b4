// The pixels that a context draws on.
#pragma once

#include "platform/gdi/context.h"
#include "platform/gdi/surface.h"

namespace seam {

struct Canvas {
    PixelView view;
    RECT clip{0, 0, 0, 0}; // what may be drawn on, within the picture
    bool monochrome = false;
    Surface* surface = nullptr; // has to be told before pixels change; null for a bitmap

    DWORD* at(int x, int y) const {
        return view.bits + static_cast<std::ptrdiff_t>(y) * view.stride + x;
    }
};

/// Empty for a window's context whose surface has gone. On the bitmap of a fresh context, which all
/// contexts share, nothing may be drawn: its clip is empty.
Canvas canvasOf(const DeviceContext& context);

/// Whether it draws on a monochrome bitmap.
bool isMonochrome(const DeviceContext& context);

/// A colour as the context's pixels show it. On a monochrome bitmap the background colour is white
/// and every other black.
DWORD pixelOf(const DeviceContext& context, const Canvas& canvas, COLORREF colour);

/// The colour in the form of pixels.
constexpr DWORD opaquePixel(COLORREF colour) {
    return 0xFF000000U | ((colour & 0xFFU) << 16U) | (colour & 0xFF00U) | ((colour >> 16U) & 0xFFU);
}

/// What two rectangles share; its sizes may be below 0, when there is nothing.
RECT intersection(const RECT& a, const RECT& b);
bool isEmpty(const RECT& area);

/// Tells the surface of an area that isn't empty and lies within the clip.
void touch(const Canvas& canvas, const RECT& area);

/// Fills what lies within the clip.
void fillArea(const Canvas& canvas, const RECT& area, DWORD pixel);

} // namespace seam

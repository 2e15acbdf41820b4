// Device contexts: what they draw on, and how.
#pragma once

#include "platform/gdi.h"
#include "platform/gdi/surface.h"

#include <vector>

namespace seam {

/// What SaveDC keeps.
struct DrawState {
    HBITMAP bitmap;
    HPEN pen;
    HBRUSH brush;
    HFONT font;
    HPALETTE palette;
    COLORREF background = RGB(255, 255, 255);
    COLORREF text = RGB(0, 0, 0);
    int backgroundMode = OPAQUE;
    int stretchMode = BLACKONWHITE;
    POINT position{0, 0};
};

struct DeviceContext {
    bool ofWindow = false;
    Surface* surface = nullptr; // of a window's context; null once the surface has gone
    RECT clip{0, 0, 0, 0};      // of a window's context
    DrawState state;
    std::vector<DrawState> saved;
};

/// Null if there is no such context.
DeviceContext* findContext(HDC dc);

std::size_t liveContexts();

/// Palettes know how often contexts have them selected. holdPalette does nothing for a palette that
/// isn't there.
HPALETTE defaultPalette();
void holdPalette(HPALETTE palette, int change);
std::size_t livePalettes();

} // namespace seam

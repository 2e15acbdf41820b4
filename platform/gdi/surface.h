// What a device context of a window draws into. Only the seam includes it.
#pragma once

#include "platform/types.h"

namespace seam {

/// Pixels in the display's form, 0x00rrggbb, `stride` pixels from row to row. The top byte of a
/// pixel means nothing; what is written leaves it 0xFF where the window system wants that.
struct PixelView {
    DWORD* bits = nullptr;
    int width = 0;
    int height = 0;
    int stride = 0;
};

/// The picture of a window: where drawing on it goes. It outlives no window; a context whose
/// surface has gone draws nothing (see dropSurface).
class Surface {
  public:
    virtual ~Surface() = default;

    /// The pixels as they are now; good until the next message is handled.
    virtual PixelView pixels() = 0;

    /// The rectangle, which lies within the picture, is about to be drawn on and has to reach the
    /// screen. Called before its pixels change.
    virtual void touch(const RECT& area) = 0;
};

/// A context that draws on the surface, within clip (in its pixels). Ended by DeleteDC.
HDC makeSurfaceContext(Surface& surface, const RECT& clip);

/// Contexts of this surface draw nothing from now on.
void dropSurface(Surface& surface);

} // namespace seam

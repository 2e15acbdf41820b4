#include "platform/gdi/canvas.h"

#include "platform/gdi/objects.h"
#include "platform/gdi/rows.h"

#include <algorithm>

namespace seam {

Canvas canvasOf(const DeviceContext& context) {
    Canvas canvas;
    if (context.ofWindow) {
        canvas.surface = context.surface;
        if (context.surface != nullptr) {
            canvas.view = context.surface->pixels();
        }
        canvas.clip = intersection(context.clip, RECT{0, 0, canvas.view.width, canvas.view.height});
    } else if (auto* bitmap = findObjectAs<Bitmap>(context.state.bitmap)) {
        canvas.view = bitmap->view();
        canvas.monochrome = bitmap->monochrome;
        if (context.state.bitmap != defaultBitmap()) {
            canvas.clip = {0, 0, bitmap->width, bitmap->height};
        }
    }
    return canvas;
}

bool isMonochrome(const DeviceContext& context) {
    const auto* bitmap = context.ofWindow ? nullptr : findObjectAs<Bitmap>(context.state.bitmap);
    return bitmap != nullptr && bitmap->monochrome;
}

DWORD pixelOf(const DeviceContext& context, const Canvas& canvas, COLORREF colour) {
    const DWORD pixel = opaquePixel(colour);
    if (!canvas.monochrome) {
        return pixel;
    }
    return pixel == opaquePixel(context.state.background) ? whitePixel : blackPixel;
}

RECT intersection(const RECT& a, const RECT& b) {
    return {std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
            std::min(a.bottom, b.bottom)};
}

bool isEmpty(const RECT& area) {
    return area.left >= area.right || area.top >= area.bottom;
}

void touch(const Canvas& canvas, const RECT& area) {
    if (canvas.surface != nullptr) {
        canvas.surface->touch(area);
    }
}

void fillArea(const Canvas& canvas, const RECT& area, DWORD pixel) {
    const RECT inside = intersection(area, canvas.clip);
    if (isEmpty(inside)) {
        return;
    }
    touch(canvas, inside);
    const auto width = static_cast<std::size_t>(inside.right - inside.left);
    for (int y = inside.top; y < inside.bottom; ++y) {
        fillRow(canvas.at(inside.left, y), width, pixel);
    }
}

} // namespace seam

#include "platform/gdi/context.h"

#include "platform/gdi/objects.h"

#include <algorithm>
#include <utility>

namespace seam {

namespace {

HandleTable<DeviceContext>& contexts() {
    static auto& table = *new HandleTable<DeviceContext>(HandleKind::deviceContext);
    return table;
}

void holdObject(HGDIOBJ object, HDC dc, int change) {
    if (GdiObject* const found = findObject(object)) {
        found->selections += change;
        found->selector = dc;
    }
}

/// Counts what the state has selected (+1), or no longer has (-1).
void holdState(const DrawState& state, HDC dc, int change) {
    holdObject(state.bitmap, dc, change);
    holdObject(state.pen, dc, change);
    holdObject(state.brush, dc, change);
    holdObject(state.font, dc, change);
    holdPalette(state.palette, change);
}

HDC addContext(DeviceContext context) {
    context.state.bitmap = defaultBitmap();
    context.state.pen = HPEN{GetStockObject(BLACK_PEN)};
    context.state.brush = HBRUSH{GetStockObject(WHITE_BRUSH)};
    context.state.font = HFONT{GetStockObject(SYSTEM_FONT)};
    context.state.palette = defaultPalette();
    const DrawState state = context.state;
    const HDC dc{contexts().add(std::make_unique<DeviceContext>(std::move(context)))};
    if (dc) {
        holdState(state, dc, +1);
    }
    return dc;
}

/// Puts the object into its place in the state and gives what stood there.
template <class Kind>
HGDIOBJ replace(Kind& place, HGDIOBJ object, HDC dc) {
    const HGDIOBJ before = place;
    holdObject(object, dc, +1);
    holdObject(before, dc, -1);
    place = Kind{object};
    return before;
}

bool maySelectBitmap(const DeviceContext& context, const GdiObject& bitmap, HDC dc) {
    return !context.ofWindow && (bitmap.stock || bitmap.selections == 0 || bitmap.selector == dc);
}

} // namespace

DeviceContext* findContext(HDC dc) {
    return contexts().find(dc.number);
}

std::size_t liveContexts() {
    return contexts().live();
}

HDC makeSurfaceContext(Surface& surface, const RECT& clip) {
    DeviceContext context;
    context.ofWindow = true;
    context.surface = &surface;
    context.clip = clip;
    return addContext(std::move(context));
}

void dropSurface(Surface& surface) {
    contexts().forEach([&surface](DWORD, DeviceContext& context) {
        if (context.surface == &surface) {
            context.surface = nullptr;
        }
    });
}

} // namespace seam

using namespace seam;

HDC CreateCompatibleDC(HDC /*dc*/) {
    return addContext({});
}

BOOL DeleteDC(HDC dc) {
    const auto context = contexts().take(dc.number);
    if (!context) {
        return FALSE;
    }
    holdState(context->state, dc, -1);
    for (const DrawState& state : context->saved) {
        holdState(state, dc, -1);
    }
    return TRUE;
}

int SaveDC(HDC dc) {
    DeviceContext* const context = findContext(dc);
    if (context == nullptr) {
        return 0;
    }
    holdState(context->state, dc, +1);
    context->saved.push_back(context->state);
    return static_cast<int>(context->saved.size());
}

BOOL RestoreDC(HDC dc, int saved) {
    DeviceContext* const context = findContext(dc);
    const int count = context == nullptr ? 0 : static_cast<int>(context->saved.size());
    const int level = saved < 0 ? count + 1 + saved : saved;
    if (level < 1 || level > count) {
        return FALSE;
    }
    while (static_cast<int>(context->saved.size()) >= level) {
        holdState(context->state, dc, -1);
        context->state = context->saved.back();
        context->saved.pop_back();
    }
    return TRUE;
}

HGDIOBJ SelectObject(HDC dc, HGDIOBJ object) {
    DeviceContext* const context = findContext(dc);
    const GdiObject* const found = findObject(object);
    if (context == nullptr || found == nullptr) {
        return {};
    }
    if (std::holds_alternative<Pen>(found->value)) {
        return replace(context->state.pen, object, dc);
    }
    if (std::holds_alternative<Brush>(found->value)) {
        return replace(context->state.brush, object, dc);
    }
    if (std::holds_alternative<Font>(found->value)) {
        return replace(context->state.font, object, dc);
    }
    return maySelectBitmap(*context, *found, dc) ? replace(context->state.bitmap, object, dc)
                                                 : HGDIOBJ{};
}

COLORREF SetBkColor(HDC dc, COLORREF colour) {
    DeviceContext* const context = findContext(dc);
    return context == nullptr ? 0 : std::exchange(context->state.background, colour);
}

COLORREF SetTextColor(HDC dc, COLORREF colour) {
    DeviceContext* const context = findContext(dc);
    return context == nullptr ? 0 : std::exchange(context->state.text, colour);
}

int SetBkMode(HDC dc, int mode) {
    DeviceContext* const context = findContext(dc);
    return context == nullptr || (mode != OPAQUE && mode != TRANSPARENT)
               ? 0
               : std::exchange(context->state.backgroundMode, mode);
}

int SetStretchBltMode(HDC dc, int mode) {
    DeviceContext* const context = findContext(dc);
    return context == nullptr || mode != BLACKONWHITE
               ? 0
               : std::exchange(context->state.stretchMode, mode);
}

int SetMapMode(HDC dc, int mode) {
    return mode == MM_TEXT ? GetMapMode(dc) : 0;
}

int GetMapMode(HDC dc) {
    return findContext(dc) == nullptr ? 0 : MM_TEXT;
}

BOOL DPtoLP(HDC dc, POINT* points, int count) {
    return findContext(dc) != nullptr && points != nullptr && count >= 0 ? TRUE : FALSE;
}

BOOL MoveToEx(HDC dc, int x, int y, POINT* before) {
    DeviceContext* const context = findContext(dc);
    if (context == nullptr) {
        return FALSE;
    }
    const POINT old = std::exchange(context->state.position, POINT{x, y});
    if (before != nullptr) {
        *before = old;
    }
    return TRUE;
}

#include "platform/gdi/context.h"
#include "platform/handle_table.h"

#include <utility>

namespace seam {

namespace {

/// The display shows every colour, so that the entries themselves are of no use.
struct Palette {
    int selections = 0;
};

HandleTable<Palette>& palettes() {
    static auto& table = *new HandleTable<Palette>(HandleKind::palette);
    return table;
}

} // namespace

HPALETTE defaultPalette() {
    static const HPALETTE stock{palettes().add(std::make_unique<Palette>())};
    return stock;
}

void holdPalette(HPALETTE palette, int change) {
    if (Palette* const found = palettes().find(palette.number)) {
        found->selections += change;
    }
}

std::size_t livePalettes() {
    defaultPalette();
    return palettes().live() - 1;
}

} // namespace seam

using namespace seam;

HPALETTE CreatePalette(const LOGPALETTE* palette) {
    constexpr WORD version = 0x300;
    if (palette == nullptr || palette->palVersion != version) {
        return {};
    }
    return HPALETTE{palettes().add(std::make_unique<Palette>())};
}

HPALETTE SelectPalette(HDC dc, HPALETTE palette, BOOL /*background*/) {
    DeviceContext* const context = findContext(dc);
    if (context == nullptr || palettes().find(palette.number) == nullptr) {
        return {};
    }
    holdPalette(palette, +1);
    holdPalette(context->state.palette, -1);
    return std::exchange(context->state.palette, palette);
}

UINT RealizePalette(HDC /*dc*/) {
    return 0;
}

BOOL DeletePalette(HPALETTE palette) {
    const Palette* const found = palettes().find(palette.number);
    if (found == nullptr || palette == defaultPalette() || found->selections > 0) {
        return FALSE;
    }
    palettes().take(palette.number);
    return TRUE;
}

// The objects that a device context can select, and their table.
#pragma once

#include "platform/gdi.h"
#include "platform/gdi/font.h"
#include "platform/gdi/mosaic.h"
#include "platform/gdi/pixel_block.h"
#include "platform/gdi/surface.h"
#include "platform/handle_table.h"

#include <memory>
#include <variant>

namespace seam {

struct Bitmap {
    int width = 0;
    int height = 0;
    bool monochrome = false;
    PixelBlock pixels;              // of any contents while there is a mosaic
    std::unique_ptr<Mosaic> mosaic; // what the picture is instead, until somebody needs its pixels

    /// The pixels, to be read and changed.
    PixelView view();
};

/// A line one pixel wide; the null pen isn't visible.
struct Pen {
    COLORREF colour = 0;
    bool visible = true;
};

/// The same of a filling.
struct Brush {
    COLORREF colour = 0;
    bool visible = true;
};

struct GdiObject {
    std::variant<Bitmap, Pen, Brush, Font> value;
    bool stock = false; // lives for ever, isn't counted
    int selections = 0; // how often contexts have it selected, in states they keep too
    HDC selector{};     // the last context that selected it
};

/// Takes an object in; null if the table is full.
HGDIOBJ addObject(std::variant<Bitmap, Pen, Brush, Font> value);

GdiObject* findObject(HGDIOBJ handle);

/// The object if it is one of the wanted kind, else null.
template <class Kind>
Kind* findObjectAs(HGDIOBJ handle) {
    GdiObject* const object = findObject(handle);
    return object == nullptr ? nullptr : std::get_if<Kind>(&object->value);
}

/// The 1 x 1 monochrome bitmap that every fresh context holds.
HBITMAP defaultBitmap();

/// A bitmap with pixels of any contents; one without pixels for a size below 1, a size out of all
/// reason, or if there is no memory.
Bitmap makeBitmap(int width, int height, bool monochrome);

} // namespace seam

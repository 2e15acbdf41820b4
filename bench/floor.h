// The least that a step of a walk can cost: two passes over pixels, and no program round them.
#pragma once

#include "platform/gdi/surface.h"

/// Copies a picture of size x size pixels onto the view.
void RestorePlain(const seam::PixelView& view, int x, int y, const DWORD* picture, int size);

/// Puts a picture of size x size pixels, in which black is see-through, onto the view.
void CompositePlain(const seam::PixelView& view, int x, int y, const DWORD* picture, int size);

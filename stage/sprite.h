// Pictures on the stage in which black is see-through, and what lies under them.
//
// Pictures go straight on the window, over the backdrop. The see-through colour is pure black and
// nothing else: a black pixel within a figure is a hole. No result of a platform call is looked at,
// and the order of calls is the caller's: first x and y, then SpriteStamp, then anything else; take
// a Sprite off with SpriteRestoreUnder before what lies under it is painted anew. All bitmaps of
// one Sprite have one size.
#pragma once

#include "platform/gdi.h"

/// A fresh one is all zero.
struct Sprite {
    LONG x; // logical place; equal to drawX, drawY at rest
    LONG y;
    LONG drawX; // where the picture stands on the stage, or beyond it
    LONG drawY;
    LONG cx; // size in pixels of the bitmap last stamped
    LONG cy;
    HBITMAP frameBitmap; // what the image was last made from; the caller's, only borrowed
    HBITMAP image;       // the picture in the display's form; owned
    HBITMAP savedUnder;  // the stage at (drawX, drawY) without this Sprite; owned
};

/// Makes the image from the bitmap, takes its size, and sets the draw place to the logical one.
/// Draws nothing and leaves savedUnder alone.
void SpriteStamp(HDC dc, HBITMAP bitmap, Sprite* sprite);

/// Takes savedUnder anew from what dc shows at the draw place.
void SpriteSaveUnder(HDC dc, Sprite* sprite);

/// Puts savedUnder back on dc; it stays as it is. Nothing before the first stamp or save.
void SpriteRestoreUnder(HDC dc, const Sprite* sprite);

/// Draws the image on dc in one write.
void SpriteDraw(HDC dc, const Sprite* sprite);

/// Moves the Sprite by the difference between its logical place and (x, y), which becomes the
/// logical place, and shows its present image there; the picture that stood before may be another.
/// The window shows nothing but finished pictures meanwhile. savedUnder must be what lies under the
/// present place, unless that lies wholly outside the window.
void SpriteMove(HWND window, Sprite* sprite, LONG x, LONG y);

/// Nonzero if the point lies in the Sprite's rectangle, see-through corners included.
BOOL SpriteHitTest(const Sprite* sprite, POINT point);

/// Deletes the bitmap if there is one, and forgets it.
void FreeBitmap(HBITMAP* bitmap);

/// Frees what the Sprite owns and forgets all three bitmaps.
void SpriteFree(Sprite* sprite);

/// Draws a bitmap on dc with black see-through, and leaves nothing else behind.
void SpriteStampOnce(HDC dc, HBITMAP bitmap, LONG x, LONG y);

// Small routines that give windows their three-dimensional look and the stage its titles.
//
// All draw through a context that the caller owns and take out again what they select, unless a
// line says otherwise. Colours of bevels and shadows are read with GetSysColor at each call:
// COLOR_BTNSHADOW is the dark side, COLOR_BTNHIGHLIGHT the light one. No failure is reported.
#pragma once

#include "platform/gdi.h"

/// One ring of one pixel on the rectangle: left and top side with the first pen, right and bottom
/// side with the second. The pixel at (left + 1, bottom - 1) isn't touched.
void DrawBevelEdge(HDC dc, int left, int top, int right, int bottom, HPEN first, HPEN second);

/// |width| rings, from the rectangle inwards: sunken for a width above 0, raised below 0.
void DrawBevel(HDC dc, int left, int top, int right, int bottom, int width);

/// A bevel, and Rectangle with the caller's pen and brush on what it leaves; gives its result.
BOOL DrawBevelBox(HDC dc, int left, int top, int right, int bottom, int width);

/// The text `depth` times up and left in the first colour, then `depth` times down and right in
/// the second, each pass one pixel on. Only the rectangle's left and top move: since the text is
/// centred, it goes half as far to the side as up or down. Nothing for a depth below 1.
void DrawShadowPasses(HDC dc, const char* text, int depth, int left, int top, int right, int bottom,
                      COLORREF first, COLORREF second);

/// Centred text with a light and a dark edge: it stands out for a depth above 0 and is sunk in
/// below 0. The context's text colour is `colour` afterwards. Gives what the last DrawTextA gave.
int DrawShadowText(HDC dc, COLORREF colour, const char* text, int left, int top, int right,
                   int bottom, int depth);

/// A font whose characters are `height` pixels high.
HFONT MakeFont(int height, int weight, const char* face);

/// Copies the top left part of the bitmap to the rectangle, without stretching.
void BlitPicture(HDC dc, int left, int top, int right, int bottom, HBITMAP bitmap);

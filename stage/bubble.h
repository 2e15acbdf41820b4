// The speech bubble: a white balloon beside the character's mouth, with his text in it. Bubble and
// text exist on the screen only; a repaint wipes them.
//
// The order is always PlaceBubble, ShowBubble, later HideBubble, all with the same window. The
// bubble has to come off before the character moves: what it covers may be part of him.
#pragma once

#include "stage/sprite.h"

extern Sprite BubbleSprite; // frameBitmap is borrowed from the two bubble bitmaps

constexpr LONG BUBBLE_RIGHT = 1; // right of the anchor, its tail at its left edge
constexpr LONG BUBBLE_LEFT = 2;  // left of the anchor, as any value but BUBBLE_RIGHT
/// The side on which the bubble stands. Written by ChooseBubbleSide.
extern LONG BubbleSide;

/// 1 while no arrival display is up. Written here, by StageBegin, FreeCharacterArt,
/// PrepareRandomWalk and ArrivalPause, which clears it for an arrival without a text too.
extern DWORD BubbleHidden;

/// Loads both bubble bitmaps and makes BubbleSprite know their size. LoadCharacterArt frees those
/// of before first.
void LoadBubbleArt(HWND stage, HINSTANCE instance);
void FreeBubbleArt();

/// Picks anchor and side by where the character stands and where he came from, and makes the
/// bubble's image. Draws nothing.
void PlaceBubble(HWND stage);

/// Draws the bubble where PlaceBubble put it and writes the text, at most 69 characters and a NUL.
void ShowBubble(HWND stage, const char* text);

/// Puts back what lay under the bubble, if one stands, and sets BubbleHidden.
void HideBubble(HWND stage);

/// A repaint of the stage has wiped the bubble, if one stands: what HideBubble puts back is taken
/// anew from dc, for the stage may look different now.
void SaveUnderBubble(HDC dc);

/// Sets BubbleSide by the anchor and the direction of the last walk, then PositionBubble. The
/// bubble stands in front of him unless he is in that outer quarter of the stage or it doesn't fit
/// there.
void ChooseBubbleSide(HWND stage, LONG anchorX, LONG anchorY, LONG direction);

/// Takes the bitmap of BubbleSide and places the bubble 15 pixels beside the anchor.
void PositionBubble(HWND stage, LONG anchorX, LONG anchorY);

/// Writes the text into the bubble, centred, lines broken at words and carriage returns, cut at the
/// lower edge. Gives what DrawTextA gave.
int DrawBubbleText(HWND stage, const char* text);

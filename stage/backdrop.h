// The stage's picture: one small tile repeated edge to edge, built once into a bitmap of the
// stage's size; and the repaint of a stage window: backdrop, titles, character.
#pragma once

#include "platform/user.h"

/// The stage-sized picture, null before the first build. Owned here; the editor deletes it at its
/// end and sets it to null.
extern HBITMAP BackdropBitmap;

/// 1 once the big title has been painted. Set here, cleared by the stage's host.
extern DWORD TitleShown;

constexpr int STAGE_TITLE_SIZE = 30; // NUL included
/// The big title of the first paint. Written by the stage's host.
extern char StageTitle[STAGE_TITLE_SIZE];

/// Made at the start of a stage by its host and deleted at its end.
extern HFONT TitleFont;
extern HFONT BylineFont;

/// Replaces BackdropBitmap by one for BackgroundIndex and StageSize; gives the new one, null if it
/// can't be made.
HBITMAP RebuildBackdrop(HWND stage, HINSTANCE instance);

/// A new bitmap of the stage's size, tiled; null if it can't be made. A background without a tile
/// of its number shows bg01.
HBITMAP BuildBackdrop(HINSTANCE instance, HWND stage);

constexpr int TILE_NAME_SIZE = 16; // bytes, the NUL included

/// Writes the name of the tile of a number: "bg01", "bg10".
void TileName(char* name, LONG index);

/// Blanks the stage (BlankStage) and loads the tile bgNN; null if there is none.
HBITMAP LoadNumberedTile(HINSTANCE instance, HDC dc, LONG index);

/// Loads a bitmap resource by way of its palette; null if there is no such resource.
HBITMAP LoadPaletteBitmap(HINSTANCE instance, HDC dc, const char* name);

/// Covers the area's size, from the target's origin, with copies of the bitmap; those at the right
/// and the bottom are cut by the target. Nothing for no bitmap.
void TileBitmap(HDC dc, LONG left, LONG top, LONG right, LONG bottom, HBITMAP bitmap);

/// Shows a grey stage with a black line round it until the next paint: only in a saver or player
/// window, with Backgrounds on, once the title has been painted.
void BlankStage(HDC dc);

/// Copies a stage-sized bitmap to the whole stage; nothing for no bitmap.
void BlitBackdrop(HDC dc, HWND stage, HBITMAP bitmap);

/// Paints a stage window in its WM_PAINT. While *repaintFlag is nonzero what lies under the
/// character is saved afresh, and the flag cleared. Always 0.
LRESULT PaintStage(HWND stage, DWORD* repaintFlag);

/// The big title and the byline on the first paint; later the caption, in the saver and the player
/// only.
void DrawTitles(HDC dc, HWND stage);

/// The preview's title, on every paint.
void DrawPreviewTitle(HDC dc, HWND stage);

/// The editor's stage has got WM_SIZE: puts it back to its place and to StageSize, and makes the
/// character's image anew. Always 0.
LRESULT ResizeStage(HWND stage);

// Device contexts, bitmaps, pens, brushes, fonts, text and palettes.
//
// A bitmap is a memory picture: 32 bits a pixel in the display's form (0x00rrggbb), or monochrome.
// A device context draws into the bitmap selected into it or into the surface of a window; what
// lies outside the target, negative positions included, is clipped. All drawing runs in MM_TEXT: a
// logical unit is a pixel. A fresh context has a 1 x 1 monochrome bitmap, black pen and text,
// white brush and background, OPAQUE mode. An operation with a stale or foreign handle gives 0.
#pragma once

#include "platform/types.h"

constexpr COLORREF RGB(int red, int green, int blue) {
    return static_cast<COLORREF>(red | (green << 8) | (blue << 16));
}

// ---- Device contexts -------------------------------------------------------------------------

/// A memory context. The argument only says which display it is compatible with. Nothing can be
/// drawn on the bitmap of a fresh one.
HDC CreateCompatibleDC(HDC dc);
BOOL DeleteDC(HDC dc);

/// Keeps the context's state, selected objects included; gives the number of states kept.
int SaveDC(HDC dc);

/// Brings back state `saved`, counted from 1, or from the last one if negative (-1).
BOOL RestoreDC(HDC dc, int saved);

/// Puts a bitmap, pen, brush or font in the place of the present one and gives that one; null if
/// the object is none, or is a bitmap that another context has selected, or dc belongs to a window
/// and the object is a bitmap.
HGDIOBJ SelectObject(HDC dc, HGDIOBJ object);

/// Frees a bitmap, pen, brush or font. FALSE, and nothing done, for a stock object and for one
/// that a context has selected.
BOOL DeleteObject(HGDIOBJ object);

constexpr int WHITE_BRUSH = 0;
constexpr int LTGRAY_BRUSH = 1;
constexpr int BLACK_BRUSH = 4;
constexpr int NULL_BRUSH = 5;
constexpr int WHITE_PEN = 6;
constexpr int BLACK_PEN = 7;
constexpr int NULL_PEN = 8;
constexpr int SYSTEM_FONT = 13;
HGDIOBJ GetStockObject(int index);

/// Each gives the value that stood before. A fresh context's are white, black and OPAQUE.
COLORREF SetBkColor(HDC dc, COLORREF colour);
COLORREF SetTextColor(HDC dc, COLORREF colour);

constexpr int TRANSPARENT = 1;
constexpr int OPAQUE = 2;
int SetBkMode(HDC dc, int mode);

constexpr int MM_TEXT = 1;
int SetMapMode(HDC dc, int mode); ///< 0, and nothing changed, for any mode but MM_TEXT
int GetMapMode(HDC dc);
BOOL DPtoLP(HDC dc, POINT* points, int count);

// ---- Bitmaps -----------------------------------------------------------------------------------

/// What GetObjectA tells of a bitmap. bmBits is always null.
struct BITMAP {
    LONG bmType;
    LONG bmWidth;
    LONG bmHeight;
    LONG bmWidthBytes;
    WORD bmPlanes;
    WORD bmBitsPixel; // 1 or 32
    void* bmBits;
};

/// A bitmap of the form of what is selected into dc: of the display's form for a window's context
/// and for a memory context with a colour bitmap, monochrome for a fresh memory context. All its
/// pixels are 0. Null for a size below 1 or if there is no memory.
HBITMAP CreateCompatibleBitmap(HDC dc, int width, int height);

/// Fills the BITMAP record of a bitmap and gives its size in bytes; 0 if `size` doesn't hold it.
int GetObjectA(HGDIOBJ object, int size, void* record);

/// A bitmap of the display's form from bitmap resource `name`; null if there is none.
HBITMAP LoadBitmapA(HINSTANCE instance, ResourceName name);

constexpr DWORD SRCCOPY = 0x00CC0020;
constexpr DWORD SRCAND = 0x008800C6;
constexpr DWORD SRCPAINT = 0x00EE0086;

/// Copies a rectangle by one of the three operations. From a colour source to a monochrome target
/// a pixel of the source context's background colour becomes 1 and every other 0; from a
/// monochrome source to a colour target 1 becomes the target context's background colour and 0 its
/// text colour. Pixels outside the source leave the target as it was. Source and target may be the
/// same. FALSE for another operation.
BOOL BitBlt(HDC target, int x, int y, int width, int height, HDC source, int sourceX, int sourceY,
            DWORD operation);

constexpr int BLACKONWHITE = 1;
int SetStretchBltMode(HDC dc, int mode); ///< gives the mode before; BLACKONWHITE at first

/// As BitBlt, with the source rectangle stretched to the target's size by repeating or leaving out
/// rows and columns. Sizes are at least 1.
BOOL StretchBlt(HDC target, int x, int y, int width, int height, HDC source, int sourceX,
                int sourceY, int sourceWidth, int sourceHeight, DWORD operation);

// ---- Pictures from bytes -----------------------------------------------------------------------

/// The head of a device-independent bitmap, followed by a colour table of four bytes a colour,
/// blue, green, red, 0, and rows of pixels from the bottom up, each filled up to four bytes.
struct BITMAPINFOHEADER {
    DWORD biSize; // 40
    LONG biWidth;
    LONG biHeight;
    WORD biPlanes;
    WORD biBitCount;
    DWORD biCompression;
    DWORD biSizeImage;
    LONG biXPelsPerMeter;
    LONG biYPelsPerMeter;
    DWORD biClrUsed; // 0: as many as biBitCount allows
    DWORD biClrImportant;
};

static_assert(sizeof(BITMAPINFOHEADER) == 40);

struct PALETTEENTRY {
    BYTE peRed;
    BYTE peGreen;
    BYTE peBlue;
    BYTE peFlags;
};

/// palPalEntry has palNumEntries elements.
struct LOGPALETTE {
    WORD palVersion; // 0x300
    WORD palNumEntries;
    PALETTEENTRY palPalEntry[1];
};

/// A palette. The display shows every colour, so that selecting and realizing one changes nothing.
HPALETTE CreatePalette(const LOGPALETTE* palette);
HPALETTE SelectPalette(HDC dc, HPALETTE palette, BOOL background); ///< the palette before
UINT RealizePalette(HDC dc);                                       ///< entries changed: always 0
BOOL DeletePalette(HPALETTE palette); ///< FALSE while a context has it selected

constexpr DWORD CBM_INIT = 4;
constexpr UINT DIB_RGB_COLORS = 0;

/// A bitmap of the display's form made from uncompressed pixels of 1, 4, 8 or 24 bits with the
/// colours of the table behind `info`; null for anything else. `pixels` holds all rows.
HBITMAP CreateDIBitmap(HDC dc, const BITMAPINFOHEADER* header, DWORD init, const void* pixels,
                       const BITMAPINFOHEADER* info, UINT usage);

// ---- Lines and shapes --------------------------------------------------------------------------

constexpr int PS_SOLID = 0;
HPEN CreatePen(int style, int width, COLORREF colour); ///< null for all but PS_SOLID, width 1
HBRUSH CreateSolidBrush(COLORREF colour);

BOOL MoveToEx(HDC dc, int x, int y, POINT* before);

/// Draws with the pen from the present position up to, but without, (x, y), and moves there.
BOOL LineTo(HDC dc, int x, int y);

/// Outlines with the pen and fills with the brush; right and bottom lie one past the last pixel.
BOOL Rectangle(HDC dc, int left, int top, int right, int bottom);
int FillRect(HDC dc, const RECT* area, HBRUSH brush);

BOOL InflateRect(RECT* rectangle, int dx, int dy);
BOOL PtInRect(const RECT* rectangle, POINT point); ///< left and top edges in, the others out

constexpr int COLOR_ACTIVECAPTION = 2;
constexpr int COLOR_BTNFACE = 15;
constexpr int COLOR_BTNSHADOW = 16;
constexpr int COLOR_BTNHIGHLIGHT = 20;
constexpr int COLOR_WINDOW = 5;
DWORD GetSysColor(int index); ///< black for an index without a colour

// ---- Text --------------------------------------------------------------------------------------
//
// Text is Windows-1252; its five holes stand for U+0081 and so on. Glyphs are drawn without
// antialiasing, at whole pixels. In OPAQUE mode a line's cells get the background colour first.

constexpr int FW_THIN = 100;
constexpr int FW_NORMAL = 400;
constexpr int FW_BOLD = 700;

/// A font. A negative height is the character height in pixels, a positive one that of the cell;
/// a weight of 600 and more is bold. "MS Serif" is drawn with Liberation Serif, anything else with
/// Liberation Sans. All other numbers must be 0. Null if one isn't, or for a height above 1000.
HFONT CreateFontA(int height, int width, int escapement, int orientation, int weight, DWORD italic,
                  DWORD underline, DWORD strikeOut, DWORD charSet, DWORD outputPrecision,
                  DWORD clipPrecision, DWORD quality, DWORD pitchAndFamily, const char* face);

constexpr UINT DT_LEFT = 0x000;
constexpr UINT DT_CENTER = 0x001;
constexpr UINT DT_VCENTER = 0x004;
constexpr UINT DT_WORDBREAK = 0x010;
constexpr UINT DT_SINGLELINE = 0x020;
constexpr UINT DT_NOCLIP = 0x100;
constexpr UINT DT_NOPREFIX = 0x800;

/// Draws `length` characters (-1: up to the NUL) from the top of the rectangle down and clips them
/// to it. A carriage return, a line feed or the pair of both breaks a line unless DT_SINGLELINE
/// stands; with DT_WORDBREAK lines break at blanks, and within a word wider than the rectangle.
/// Unless DT_NOPREFIX stands an ampersand underlines the next character, and two print one. Gives
/// the height of the text drawn, 0 on failure.
int DrawTextA(HDC dc, const char* text, int length, RECT* rectangle, UINT format);

/// The width of a line of text in the selected font and the height of a line.
BOOL GetTextExtentPointA(HDC dc, const char* text, int length, SIZE* size);

struct TEXTMETRICA {
    LONG tmHeight; // ascent + descent
    LONG tmAscent;
    LONG tmDescent;
    LONG tmInternalLeading;
    LONG tmExternalLeading;
    LONG tmAveCharWidth;
    LONG tmMaxCharWidth;
    LONG tmWeight;
};

BOOL GetTextMetricsA(HDC dc, TEXTMETRICA* metrics);

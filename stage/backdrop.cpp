#include "stage/backdrop.h"

#include "platform/drawing_kit.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "stage/bubble.h"
#include "stage/character.h"
#include "stage/stage.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

HBITMAP BackdropBitmap;
DWORD TitleShown;
char StageTitle[STAGE_TITLE_SIZE];
HFONT TitleFont;
HFONT BylineFont;

static constexpr LONG FIRST_TILE = 1;

static LONG StageWidth() {
    return LOWORD(StageSize);
}

static LONG StageHeight() {
    return HIWORD(StageSize);
}

// ---- Building -----------------------------------------------------------------------------------

void TileName(char* name, LONG index) {
    wsprintfA(name, index < 10 ? "bg0%d" : "bg%d", index);
}

/// Meant: background 0 shows bg01 by a plain load; from 1 on tiles are loaded with their palette,
/// which blanks the stage in between.
static HBITMAP LoadTile(HINSTANCE instance, HDC dc) {
    HBITMAP tile;
    if (BackgroundIndex != 0) {
        tile = LoadNumberedTile(instance, dc, BackgroundIndex);
    }
    char name[TILE_NAME_SIZE];
    TileName(name, tile ? BackgroundIndex : FIRST_TILE);
    Trace("rebuild_backdrop index=%d tile=%s", BackgroundIndex, name);
    return tile ? tile : LoadBitmapA(instance, name);
}

HBITMAP RebuildBackdrop(HWND stage, HINSTANCE instance) {
    if (BackdropBitmap) {
        DeleteObject(BackdropBitmap);
    }
    BackdropBitmap = BuildBackdrop(instance, stage);
    if (!BackdropBitmap) {
        // Meant: no bitmap of this name exists, so that a stage without memory has no backdrop.
        BackdropBitmap = LoadBitmapA(instance, "background");
    }
    return BackdropBitmap;
}

HBITMAP BuildBackdrop(HINSTANCE instance, HWND stage) {
    const HDC dc = GetDC(stage);
    const HDC memory = CreateCompatibleDC(dc);
    const HWND focusBefore = SetFocus(stage);
    const HBITMAP tile = LoadTile(instance, dc);
    SetFocus(focusBefore);
    const HBITMAP backdrop = CreateCompatibleBitmap(dc, StageWidth(), StageHeight());
    const HGDIOBJ before = SelectObject(memory, backdrop);
    TileBitmap(memory, 0, 0, StageWidth(), StageHeight(), tile);
    SelectObject(memory, before);
    DeleteDC(memory);
    ReleaseDC(stage, dc);
    DeleteObject(tile);
    return backdrop;
}

HBITMAP LoadNumberedTile(HINSTANCE instance, HDC dc, LONG index) {
    BlankStage(dc);
    char name[TILE_NAME_SIZE];
    TileName(name, index);
    return LoadPaletteBitmap(instance, dc, name);
}

static WORD CountColours(const BITMAPINFOHEADER& header) {
    if (header.biClrUsed != 0) {
        return static_cast<WORD>(header.biClrUsed);
    }
    return header.biBitCount > 8 ? 0 : static_cast<WORD>(1U << header.biBitCount);
}

/// The colour table holds blue, green, red; a palette red, green, blue.
static HPALETTE MakePalette(const BYTE* colours, WORD count) {
    constexpr WORD paletteVersion = 0x300;
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE | GMEM_ZEROINIT,
                                      sizeof(LOGPALETTE) + count * sizeof(PALETTEENTRY));
    auto* logical = static_cast<LOGPALETTE*>(GlobalLock(block));
    if (logical == nullptr) {
        GlobalFree(block);
        return nullptr;
    }
    logical->palVersion = paletteVersion;
    logical->palNumEntries = count;
    PALETTEENTRY* entries = logical->palPalEntry;
    for (int entry = 0; entry < count; ++entry, colours += 4) {
        entries[entry] = {colours[2], colours[1], colours[0], 0};
    }
    const HPALETTE palette = CreatePalette(logical);
    GlobalUnlock(block);
    GlobalFree(block);
    return palette;
}

static HBITMAP MakePaletteBitmap(HDC dc, const BYTE* resource) {
    const auto* header = reinterpret_cast<const BITMAPINFOHEADER*>(resource);
    const WORD colours = CountColours(*header);
    const HPALETTE palette = MakePalette(resource + sizeof(BITMAPINFOHEADER), colours);
    const HPALETTE before = SelectPalette(dc, palette, FALSE);
    RealizePalette(dc);
    const BYTE* pixels = resource + LOWORD(header->biSize) + colours * 4;
    const HBITMAP bitmap = CreateDIBitmap(dc, header, CBM_INIT, pixels, header, DIB_RGB_COLORS);
    SelectPalette(dc, before, FALSE);
    RealizePalette(dc);
    DeletePalette(palette);
    return bitmap;
}

HBITMAP LoadPaletteBitmap(HINSTANCE instance, HDC dc, const char* name) {
    const HRSRC found = FindResourceA(instance, name, RT_BITMAP);
    if (!found) {
        return nullptr;
    }
    const HGLOBAL resource = LoadResource(instance, found);
    const auto* bytes = static_cast<const BYTE*>(LockResource(resource));
    const HBITMAP bitmap = bytes != nullptr ? MakePaletteBitmap(dc, bytes) : HBITMAP{};
    FreeResource(resource);
    return bitmap;
}

void TileBitmap(HDC dc, LONG left, LONG top, LONG right, LONG bottom, HBITMAP bitmap) {
    BITMAP record = {};
    if (GetObjectA(bitmap, sizeof(record), &record) == 0) {
        return;
    }
    const HDC memory = CreateCompatibleDC(dc);
    const HGDIOBJ before = SelectObject(memory, bitmap);
    SetMapMode(memory, GetMapMode(dc));
    POINT tile = {record.bmWidth, record.bmHeight};
    POINT source = {0, 0};
    POINT start = {0, 0};
    DPtoLP(dc, &tile, 1);
    DPtoLP(memory, &source, 1);
    DPtoLP(memory, &start, 1);
    for (LONG y = start.y; y < bottom - top; y += tile.y) {
        for (LONG x = start.x; x < right - left; x += tile.x) {
            BitBlt(dc, x, y, tile.x, tile.y, memory, source.x, source.y, SRCCOPY);
        }
    }
    SelectObject(memory, before);
    DeleteDC(memory);
}

void BlankStage(HDC dc) {
    if (SaverActive != 1 || Backgrounds == 0 || TitleShown != 1) {
        return;
    }
    const HGDIOBJ pen = SelectObject(dc, GetStockObject(BLACK_PEN));
    const HGDIOBJ brush = SelectObject(dc, GetStockObject(LTGRAY_BRUSH));
    Rectangle(dc, 0, 0, StageWidth(), StageHeight());
    SelectObject(dc, pen);
    SelectObject(dc, brush);
}

// ---- Painting -----------------------------------------------------------------------------------

void BlitBackdrop(HDC dc, HWND /*stage*/, HBITMAP bitmap) {
    if (!bitmap) {
        return;
    }
    const HDC memory = CreateCompatibleDC(dc);
    const HGDIOBJ before = SelectObject(memory, bitmap);
    BitBlt(dc, 0, 0, StageWidth(), StageHeight(), memory, 0, 0, SRCCOPY);
    SelectObject(memory, before);
    DeleteDC(memory);
}

LRESULT PaintStage(HWND stage, DWORD* repaintFlag) {
    PAINTSTRUCT paint = {};
    const HDC dc = BeginPaint(stage, &paint);
    SaveDC(dc);
    if (CharacterArtLoaded == 1) {
        SpriteRestoreUnder(dc, &CharacterSprite);
    }
    BlitBackdrop(dc, stage, BackdropBitmap);
    if (PreviewMode == PREVIEW_WALK) {
        DrawPreviewTitle(dc, stage);
    } else {
        DrawTitles(dc, stage);
    }
    if (CharacterArtLoaded == 1) {
        const bool saves = *repaintFlag != 0;
        if (saves) {
            // After the titles, so that he walks off one without wiping it.
            SpriteSaveUnder(dc, &CharacterSprite);
            *repaintFlag = 0;
        }
        SpriteDraw(dc, &CharacterSprite);
        if (saves) {
            SaveUnderBubble(dc);
        }
    }
    RestoreDC(dc, -1);
    EndPaint(stage, &paint);
    return 0;
}

static constexpr COLORREF TITLE_COLOUR = RGB(0, 0, 255);
static constexpr COLORREF CAPTION_COLOUR = RGB(192, 192, 192);

/// Meant: painted once a run. The next repaint, whoever asks for it, takes the big title away.
static void DrawBigTitle(HDC dc, const RECT& client) {
    constexpr LONG titleAboveMiddle = 170;
    constexpr LONG bylineAboveMiddle = 80;
    const LONG middle = client.bottom / 2;
    DrawShadowText(dc, TITLE_COLOUR, StageTitle, client.left, middle - titleAboveMiddle,
                   client.right, client.bottom, 2);
    SelectObject(dc, BylineFont);
    DrawShadowText(dc, TITLE_COLOUR, "by Quarn Software", client.left, middle - bylineAboveMiddle,
                   client.right, client.bottom, 1);
    TitleShown = 1;
}

void DrawTitles(HDC dc, HWND stage) {
    RECT client = {};
    GetClientRect(stage, &client);
    const int mapMode = SetMapMode(dc, MM_TEXT);
    const HGDIOBJ font = SelectObject(dc, TitleFont);
    if (TitleShown == 0) {
        DrawBigTitle(dc, client);
    } else if (SaverActive == 1) {
        SelectObject(dc, BylineFont);
        DrawShadowText(dc, CAPTION_COLOUR, CaptionText, client.left, client.top, client.right,
                       client.bottom, 1);
    }
    SelectObject(dc, font);
    SetMapMode(dc, mapMode);
}

void DrawPreviewTitle(HDC dc, HWND stage) {
    constexpr LONG belowTop = 20;
    RECT client = {};
    GetClientRect(stage, &client);
    const int mapMode = SetMapMode(dc, MM_TEXT);
    const HGDIOBJ font = SelectObject(dc, BylineFont);
    DrawShadowText(dc, TITLE_COLOUR, "Fenky Dorbo's\rRematch", client.left, client.top + belowTop,
                   client.right, client.bottom, 1);
    SelectObject(dc, font);
    SetMapMode(dc, mapMode);
}

LRESULT ResizeStage(HWND stage) {
    constexpr int stageLeft = 10;
    constexpr int stageTop = 25;
    const HDC dc = GetDC(stage);
    MoveWindow(stage, stageLeft, stageTop, StageWidth(), StageHeight(), TRUE);
    if (CharacterArtLoaded == 1) {
        SpriteStamp(dc, CharacterSprite.frameBitmap, &CharacterSprite);
    }
    ReleaseDC(stage, dc);
    return 0;
}

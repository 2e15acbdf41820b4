#include "editor/chrome.h"

#include "platform/drawing_kit.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "stage/backdrop.h"
#include "stage/player.h"
#include "stage/stage.h"
#include "toon/toon_document.h"

#include <cstring>

HWND FileButton;
HWND PlayButton;
HWND WalkButton;
HWND MinimizeButton;
HWND CloseButton;

RECT FrameRect;
RECT CaptionLeftCap;
RECT CaptionLeftBar;
RECT CaptionTextRect;
RECT CaptionRightBar;
RECT CaptionRightCap;

static HBITMAP SysButtonsBitmap;
static HFONT ButtonFont;
static HBRUSH CaptionBrush;
static HBRUSH GreyBrush;
static HPEN CaptionPen;
static HPEN FacePen;

constexpr LONG ButtonWidth = 75;
constexpr LONG ButtonHeight = 23;
constexpr LONG SysButtonSize = 15;
constexpr LONG BELOW_BUTTONS = 9; // File and Play

// ---- What a run makes ---------------------------------------------------------------------------

void CreateChromeTools(HINSTANCE instance) {
    SysButtonsBitmap = LoadBitmapA(instance, "sysbuts");
    ButtonFont = MakeFont(14, FW_THIN, "MS Serif");
    CaptionBrush = CreateSolidBrush(GetSysColor(COLOR_ACTIVECAPTION));
    GreyBrush = HBRUSH{GetStockObject(LTGRAY_BRUSH)};
    CaptionPen = CreatePen(PS_SOLID, 1, GetSysColor(COLOR_ACTIVECAPTION));
    FacePen = CreatePen(PS_SOLID, 1, GetSysColor(COLOR_BTNFACE));
}

void DestroyChromeTools() {
    DeleteObject(SysButtonsBitmap);
    DeleteObject(ButtonFont);
    DeleteObject(CaptionBrush);
    DeleteObject(CaptionPen);
    DeleteObject(FacePen);
}

/// `spoken` is what screen readers say of a button that shows no text.
static HWND CreateButton(HWND mainWindow, HINSTANCE instance, DWORD kind, const char* spoken) {
    return CreateWindowExA(0, "button", spoken, WS_CHILD | WS_VISIBLE | kind, 0, 0, 0, 0,
                           mainWindow, nullptr, instance, nullptr);
}

static void DestroyButton(HWND* button) {
    DestroyWindow(*button);
    *button = nullptr;
}

void CreateMainButtons(HWND mainWindow, HINSTANCE instance) {
    FileButton = CreateButton(mainWindow, instance, BS_PUSHBUTTON, "");
    PlayButton = CreateButton(mainWindow, instance, BS_PUSHBUTTON, "");
    SetWindowTextA(FileButton, "&File");
    SetWindowTextA(PlayButton, "&Play");
    SendMessageA(FileButton, WM_SETFONT, ButtonFont.number, 1);
    SendMessageA(PlayButton, WM_SETFONT, ButtonFont.number, 1);
    EnableWindow(PlayButton, FALSE);
}

void DestroyMainButtons() {
    DestroyButton(&FileButton);
    DestroyButton(&PlayButton);
}

void CreateSysButtons(HWND mainWindow, HINSTANCE instance) {
    WalkButton = CreateButton(mainWindow, instance, BS_OWNERDRAW, "Walk about");
    MinimizeButton = CreateButton(mainWindow, instance, BS_OWNERDRAW, "Minimize");
    CloseButton = CreateButton(mainWindow, instance, BS_OWNERDRAW, "Close");
}

void DestroySysButtons() {
    DestroyButton(&WalkButton);
    DestroyButton(&MinimizeButton);
    DestroyButton(&CloseButton);
}

void PlaceMainButtons(HWND mainWindow) {
    RECT client{};
    GetClientRect(mainWindow, &client);
    const LONG top = client.bottom - ButtonHeight - BELOW_BUTTONS;
    MoveWindow(FileButton, MARGIN, top, ButtonWidth, ButtonHeight, TRUE);
    MoveWindow(PlayButton, client.right - ButtonWidth - MARGIN, top, ButtonWidth, ButtonHeight,
               TRUE);
}

void PlaceSysButtons(HWND mainWindow) {
    constexpr LONG top = 4;
    RECT client{};
    GetClientRect(mainWindow, &client);
    const LONG x = client.right - 2 * (5 + SysButtonSize);
    MoveWindow(WalkButton, MARGIN, top, 2 * SysButtonSize + 2, SysButtonSize, TRUE);
    MoveWindow(MinimizeButton, x, top, SysButtonSize, SysButtonSize, TRUE);
    MoveWindow(CloseButton, x + SysButtonSize, top, SysButtonSize, SysButtonSize, TRUE);
}

// ---- Places -------------------------------------------------------------------------------------

/// The caption's width in pixels; FALSE if it can't be told.
static BOOL MeasureCaption(HWND mainWindow, LONG* width) {
    const HDC dc = GetDC(mainWindow);
    const int mapMode = SetMapMode(dc, MM_TEXT);
    const HGDIOBJ font = SelectObject(dc, BylineFont);
    SIZE size{};
    const BOOL measured =
        GetTextExtentPointA(dc, CaptionText, static_cast<int>(std::strlen(CaptionText)), &size);
    *width = size.cx;
    SetMapMode(dc, mapMode);
    SelectObject(dc, font);
    ReleaseDC(mainWindow, dc);
    return measured;
}

void LayoutChrome(HWND mainWindow) {
    constexpr LONG capTop = 3;
    constexpr LONG capWidth = 2 * SysButtonSize + 5;
    constexpr LONG gap = 5; // between a bar and the text
    RECT client{};
    GetClientRect(mainWindow, &client);
    FrameRect = {MARGIN, ABOVE_STAGE, client.right - MARGIN, client.bottom - BELOW_STAGE};
    InflateRect(&FrameRect, 2, 2);
    LONG width = 0;
    if (!MeasureCaption(mainWindow, &width)) {
        return;
    }
    const LONG left = FrameRect.left;
    const LONG right = FrameRect.right;
    const LONG bottom = FrameRect.top - capTop;
    const LONG barEnd = left + (right - width - left - 2 * gap) / 2;
    CaptionLeftCap = {left, capTop, left + capWidth, bottom};
    CaptionLeftBar = {left + capWidth + 1, capTop, barEnd, bottom};
    CaptionTextRect = {barEnd + gap, capTop - 1, barEnd + gap + width, FrameRect.top - 1};
    CaptionRightBar = {barEnd + gap + width + gap, capTop, right - capWidth, bottom};
    CaptionRightCap = {right - capWidth + 1, capTop, right, bottom};
}

LRESULT ChromeHitTest(HWND mainWindow, LPARAM point) {
    const auto packed = static_cast<DWORD>(point);
    POINT at{LOWORD(packed), HIWORD(packed)};
    ScreenToClient(mainWindow, &at);
    const bool drags = PtInRect(&CaptionLeftBar, at) || PtInRect(&CaptionTextRect, at) ||
                       PtInRect(&CaptionRightBar, at);
    return drags ? HTCAPTION : HTNOWHERE;
}

// ---- Painting -----------------------------------------------------------------------------------

static void BevelRect(HDC dc, const RECT& place, int width) {
    DrawBevel(dc, place.left, place.top, place.right, place.bottom, width);
}

static void BevelBoxRect(HDC dc, const RECT& place, int width) {
    DrawBevelBox(dc, place.left, place.top, place.right, place.bottom, width);
}

void DrawButtonBoxes(HWND mainWindow, HDC dc) {
    constexpr LONG rim = 2;
    RECT client{};
    GetClientRect(mainWindow, &client);
    const LONG top = client.bottom - ButtonHeight - BELOW_BUTTONS - rim;
    const LONG bottom = client.bottom - BELOW_BUTTONS + rim;
    DrawBevel(dc, MARGIN - rim, top, MARGIN + ButtonWidth + rim, bottom, rim);
    DrawBevel(dc, client.right - MARGIN - ButtonWidth - rim, top, client.right - MARGIN + rim,
              bottom, rim);
}

static void DrawCaptionText(HDC dc) {
    const RECT& place = CaptionTextRect;
    const int mapMode = SetMapMode(dc, MM_TEXT);
    const HGDIOBJ font = SelectObject(dc, BylineFont);
    DrawShadowText(dc, RGB(0, 0, 0), CaptionText, place.left, place.top, place.right, place.bottom,
                   -1);
    SelectObject(dc, font);
    SetMapMode(dc, mapMode);
}

void PaintChrome(HWND mainWindow) {
    LayoutChrome(mainWindow);
    PAINTSTRUCT paint{};
    RECT client{};
    GetClientRect(mainWindow, &client);
    const HDC dc = BeginPaint(mainWindow, &paint);
    SaveDC(dc);
    BevelRect(dc, client, -2);
    BevelRect(dc, FrameRect, 2);
    DrawButtonBoxes(mainWindow, dc);
    DrawCaptionText(dc);
    RestoreDC(dc, -1);
    EndPaint(mainWindow, &paint);
    DrawProgress(mainWindow);
    // Meant: also where the window is inactive, until it is told so the next time.
    PaintCaptionPieces(mainWindow, TRUE);
}

void PaintCaptionPieces(HWND mainWindow, BOOL active) {
    LayoutChrome(mainWindow);
    const HDC dc = GetDC(mainWindow);
    const int mapMode = SetMapMode(dc, MM_TEXT);
    const HGDIOBJ brush = SelectObject(dc, active == TRUE ? CaptionBrush : GreyBrush);
    const HGDIOBJ pen = SelectObject(dc, active == TRUE ? CaptionPen : FacePen);
    BevelRect(dc, CaptionLeftCap, 1);
    BevelBoxRect(dc, CaptionLeftBar, 1);
    BevelBoxRect(dc, CaptionRightBar, 1);
    BevelRect(dc, CaptionRightCap, 1);
    SelectObject(dc, brush);
    SelectObject(dc, pen);
    SetMapMode(dc, mapMode);
    ReleaseDC(mainWindow, dc);
}

void DrawProgress(HWND mainWindow) {
    constexpr LONG fromEdge = ButtonWidth + 17;
    constexpr LONG least = 4; // no half this narrow is drawn
    RECT client{};
    GetClientRect(mainWindow, &client);
    const RECT bar{fromEdge, client.bottom - ButtonHeight - 8, client.right - fromEdge,
                   client.bottom - 12};
    const LONG done = bar.left + PlayProgress(bar.right - bar.left);
    const HDC dc = GetDC(mainWindow);
    const HGDIOBJ brush = SelectObject(dc, GreyBrush);
    const HGDIOBJ pen = SelectObject(dc, FacePen);
    if (bar.right - done > least) {
        DrawBevelBox(dc, done, bar.top, bar.right, bar.bottom, 2);
    }
    SelectObject(dc, CaptionBrush);
    SelectObject(dc, CaptionPen);
    if (done - bar.left > least) {
        DrawBevelBox(dc, bar.left, bar.top, done, bar.bottom, -1);
    }
    SelectObject(dc, brush);
    SelectObject(dc, pen);
    ReleaseDC(mainWindow, dc);
    Trace("progress next=%d count=%d", NextFrameIndex, FrameCount);
}

static int SysCellOf(HWND button) {
    if (button == WalkButton) {
        return 0;
    }
    return button == MinimizeButton ? 1 : 2;
}

void DrawSysButton(const DRAWITEMSTRUCT* item) {
    const bool pressed = (item->itemState & ODS_SELECTED) != 0;
    const bool disabled = (item->itemState & ODS_DISABLED) != 0;
    BevelRect(item->hDC, item->rcItem, pressed ? 2 : disabled ? 1 : -2);
    RECT picture = item->rcItem;
    InflateRect(&picture, -2, -2);
    if (pressed) {
        ++picture.left;
        ++picture.top;
    }
    BlitSysCell(item->hDC, SysButtonsBitmap, SysCellOf(item->hwndItem), picture);
}

void BlitSysCell(HDC dc, HBITMAP bitmap, int cell, const RECT& place) {
    constexpr int sources[] = {20, 0, 11}; // where the pictures begin
    const HDC memory = CreateCompatibleDC(dc);
    const HGDIOBJ before = SelectObject(memory, bitmap);
    BitBlt(dc, place.left, place.top, place.right - place.left, place.bottom - place.top, memory,
           sources[cell], 0, SRCCOPY);
    SelectObject(memory, before);
    DeleteDC(memory);
}

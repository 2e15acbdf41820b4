// The looks of the editor's main window, which has no frame of the window manager's: caption,
// buttons, a sunken frame round the stage, a bar of progress. All places are in pixels of its
// client area; no failure is reported. The bar is drawn by DrawProgress, which the stage asks for
// too (stage/editor_host.h).
#pragma once

#include "platform/dialogs.h"
#include "stage/editor_host.h"

// ---- What a run makes ---------------------------------------------------------------------------

/// The five buttons. They have no ids: whoever gets their commands knows them by their handles.
/// Null while there is no editor.
extern HWND FileButton;
extern HWND PlayButton;
extern HWND WalkButton;
extern HWND MinimizeButton;
extern HWND CloseButton;

/// Pictures, fonts, brushes and pens, made at the start of a run and deleted at its end. The two
/// colours of the caption are read once, at the start.
void CreateChromeTools(HINSTANCE instance);
void DestroyChromeTools();

/// File and Play, the latter disabled. They get their places by PlaceMainButtons.
void CreateMainButtons(HWND mainWindow, HINSTANCE instance);
void DestroyMainButtons();

/// Walk about, minimise, close; drawn by DrawSysButton, placed by PlaceSysButtons.
void CreateSysButtons(HWND mainWindow, HINSTANCE instance);
void DestroySysButtons();

void PlaceMainButtons(HWND mainWindow);
void PlaceSysButtons(HWND mainWindow);

// ---- Places -------------------------------------------------------------------------------------

constexpr LONG MARGIN = 10;      // left and right of the stage, and of the buttons
constexpr LONG ABOVE_STAGE = 25; // of caption
constexpr LONG BELOW_STAGE = 40; // of buttons

/// What the chrome adds to the stage.
constexpr int CHROME_ACROSS = 2 * MARGIN;
constexpr int CHROME_DOWN = ABOVE_STAGE + BELOW_STAGE;

/// The sunken frame, and the caption strip: two caps with buttons in them, two bars, the text
/// between. Written by LayoutChrome.
extern RECT FrameRect;
extern RECT CaptionLeftCap;
extern RECT CaptionLeftBar;
extern RECT CaptionTextRect;
extern RECT CaptionRightBar;
extern RECT CaptionRightCap;

/// Works the places out anew: the caption in force says how long the bars are. The caption strip
/// stays as it was if its text can't be measured.
void LayoutChrome(HWND mainWindow);

/// The answer to WM_NCHITTEST: HTCAPTION on the bars and on the text, which thus drag the window,
/// else HTNOWHERE.
LRESULT ChromeHitTest(HWND mainWindow, LPARAM point);

// ---- Painting -----------------------------------------------------------------------------------

/// The handler of WM_PAINT. The caption pieces come out in the active colours, whatever the window
/// is.
void PaintChrome(HWND mainWindow);

/// The caption pieces in the active colours for 1, else in grey.
void PaintCaptionPieces(HWND mainWindow, BOOL active);

/// The sunken boxes of File and Play.
void DrawButtonBoxes(HWND mainWindow, HDC dc);

/// The handler of WM_DRAWITEM: one of the three small buttons.
void DrawSysButton(const DRAWITEMSTRUCT* item);

/// Copies a picture of the small buttons (0 walk about, 1 minimise, 2 close) as far as the
/// rectangle goes and the bitmap holds.
void BlitSysCell(HDC dc, HBITMAP bitmap, int cell, const RECT& place);

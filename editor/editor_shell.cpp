#include "editor/editor_shell.h"

#include "editor/button_states.h"
#include "editor/chrome.h"
#include "editor/commands.h"
#include "platform/drawing_kit.h"
#include "platform/kernel.h"
#include "platform/menus.h"
#include "platform/trace.h"
#include "stage/backdrop.h"
#include "stage/character.h"
#include "stage/face.h"
#include "stage/play_command.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/stage.h"
#include "stage/walk.h"
#include "stage/window_loop.h"
#include "toon/settings.h"
#include "toon/toon_document.h"
#include "toon/toon_prompts.h"

HWND EditorMainWindow;
HWND EditorStage;
HCURSOR TargetCursor;

static DWORD EditorRepaintFlag = 1; // for PaintStage: keep anew what lies under him
static HWND EditorOwner;            // the setup dialog
static HINSTANCE EditorClassInstance;
static HACCEL EditorAccelerators;
static HCURSOR ArrowCursor;

constexpr const char* MAIN_CLASS = "ToonHelpClass";
constexpr const char* STAGE_CLASS = "ToonChildClass";
constexpr int PROGRAM_ICON = 100;
constexpr UINT OPENING_MS = 1200;

constexpr int CAPTION_STRING = 1;
constexpr int TITLE_STRING = 3;
constexpr int CAPTION_LIMIT = 30; // bytes of the first caption, its NUL included

// ---- A run --------------------------------------------------------------------------------------

/// Accelerators come first, wherever the focus is; then the frame editor's keys.
static int TranslateKey(const MSG* message) {
    if (TranslateAcceleratorA(EditorMainWindow, EditorAccelerators, message) != 0) {
        return 1;
    }
    return EditorDialog ? IsDialogMessageA(EditorDialog, message) : 0;
}

int RunEditor(HINSTANCE instance, HWND owner, int showCommand) {
    return RunEditorWith(instance, owner, showCommand, "");
}

int RunEditorWith(HINSTANCE instance, HWND owner, int showCommand, const char* toon) {
    EditorOwner = owner;
    if (!EditorClassInstance && !EditorClassSetup(instance)) {
        return 0;
    }
    EditorClassInstance = instance; // also if what follows fails: a class is set up once
    if (!CreateEditorWindows(instance, showCommand)) {
        return 0;
    }
    if (toon[0] != '\0') {
        ToonOpenPath(EditorMainWindow, toon);
    }
    return RunWindowLoop(EditorMainWindow, TranslateKey);
}

int EditorClassSetup(HINSTANCE instance) {
    const WORD mainClass =
        RegisterGreyClass(MAIN_CLASS, MainWindowProc, instance, LoadIconA(instance, PROGRAM_ICON));
    const WORD stageClass = RegisterGreyClass(STAGE_CLASS, StageWindowProc, instance, nullptr);
    return mainClass != 0 || stageClass != 0 ? 1 : 0;
}

int CreateEditorWindows(HINSTANCE instance, int showCommand) {
    const HWND mainWindow = CreateWindowExA(0, MAIN_CLASS, nullptr, WS_POPUP | WS_BORDER, 0, 0, 0,
                                            0, EditorOwner, nullptr, instance, nullptr);
    if (!mainWindow) {
        return 0;
    }
    EditorMainWindow = mainWindow;
    SetWindowTextA(mainWindow, StageTitle); // for lists of windows: it shows no title of its own
    ShowWindow(mainWindow, showCommand);
    UpdateWindow(mainWindow);
    EditorAccelerators = LoadAcceleratorsA(instance, "BUTTONS");
    EditorStage = CreateWindowExA(0, STAGE_CLASS, "no text", WS_CHILD | WS_VISIBLE | WS_BORDER, 0,
                                  0, 0, 0, mainWindow, nullptr, instance, nullptr);
    // The class has outlived the last run, which may have been closed in the middle of a show.
    SetClassLongA(EditorStage, GCL_HCURSOR, static_cast<LONG>(ArrowCursor.number));
    return 1;
}

void SizeMainWindow(HWND mainWindow) {
    const int screenWidth = GetSystemMetrics(SM_CXSCREEN);
    const int screenHeight = GetSystemMetrics(SM_CYSCREEN);
    StageSize = MAKELONG(screenWidth - 50, screenHeight - 100);
    const int width = LOWORD(StageSize) + 2 * GetSystemMetrics(SM_CXBORDER) + CHROME_ACROSS;
    const int height = HIWORD(StageSize) + 2 * GetSystemMetrics(SM_CYBORDER) + CHROME_DOWN;
    MoveWindow(mainWindow, (screenWidth - width) / 2, (screenHeight - height) / 2, width, height,
               TRUE);
}

static void ClearRunState() {
    StageBegin();
    BackgroundIndex = 0;
    OpeningDone = 0;
    TitleShown = 0;
    ToonFileName[0] = '\0';
    CurrentFrameIndex = 0;
    FrameCount = 1;
    EditorRepaintFlag = 1;
    ButtonsSaved = 0;
}

void EditorStartup(HWND mainWindow, HINSTANCE instance) {
    SeedRandom(WallClockSeconds());
    ClearRunState();
    LoadStringA(instance, CAPTION_STRING, CaptionText, CAPTION_LIMIT);
    LoadStringA(instance, TITLE_STRING, StageTitle, sizeof StageTitle);
    RebuildBackdrop(mainWindow, instance);
    LoadExpressionSheet(instance);
    TargetCursor = LoadCursorA(instance, "target");
    ArrowCursor = LoadCursorA(nullptr, IDC_ARROW);
    BylineFont = MakeFont(16, FW_NORMAL, "MS Serif");
    TitleFont = MakeFont(32, FW_BOLD, "MS Serif");
    CreateChromeTools(instance);
}

static void FreeFont(HFONT* font) {
    DeleteObject(*font);
    *font = nullptr;
}

void EditorShutdown() {
    if (BackdropBitmap) {
        DeleteObject(BackdropBitmap);
    }
    FreeExpressionSheet();
    FreeFont(&BylineFont);
    FreeFont(&TitleFont);
    DestroyChromeTools();
    DestroyCursor(TargetCursor);
    DestroyCursor(ArrowCursor);
    BackdropBitmap = nullptr;
}

void CentreDialog(HWND window) {
    RECT place{};
    GetWindowRect(window, &place);
    const int width = place.right - place.left;
    const int height = place.bottom - place.top;
    MoveWindow(window, (GetSystemMetrics(SM_CXSCREEN) - width) / 2,
               (GetSystemMetrics(SM_CYSCREEN) - height) / 2, width, height, FALSE);
}

// ---- The main window ----------------------------------------------------------------------------

static void OpenMainWindow(HWND window, HINSTANCE instance) {
    SettingsLoad();
    SizeMainWindow(window);
    EditorStartup(window, instance);
    CreateFilePopup();
    CreateMainButtons(window, instance);
    CreateSysButtons(window, instance);
    SetTimer(window, TIMER_OPENING, OPENING_MS, nullptr);
}

/// Meant: nothing of a Toon is saved, and nobody asks.
static void CloseMainWindow() {
    StopWalkTimer(EditorStage);
    DestroyMainButtons();
    DestroySysButtons();
    EditorShutdown();
    DestroyFilePopup();
    FrameStoreFree();
    SettingsSave();
    PostQuitMessage(0);
    EditorMainWindow = nullptr;
    EditorDialog = nullptr;
}

static void PlaceInMainWindow(HWND window) {
    SendMessageA(EditorStage, WM_SIZE, 0, 0);
    PlaceMainButtons(window);
    PlaceSysButtons(window);
}

static void ActivateMainWindow(HWND window, WPARAM how) {
    EditorRepaintFlag = 1;
    const bool active = how == WA_ACTIVE || how == WA_CLICKACTIVE;
    if (!active) {
        SuspendPlayback(EditorStage);
    }
    PaintCaptionPieces(window, active ? TRUE : FALSE);
}

static void ShowNewBackdrop(HWND window, HINSTANCE instance) {
    RebuildBackdrop(EditorStage, instance);
    EditorRepaintFlag = 1;                 // what lies under him is another now
    InvalidateRect(window, nullptr, TRUE); // the stage, which lies in it, too
}

static void LeaveFrameEditor() {
    SetClassLongA(EditorStage, GCL_HCURSOR, static_cast<LONG>(ArrowCursor.number));
    if (ShowUnderWay()) {
        EndShow();
    } else {
        ResetShow(EditorStage);
    }
    EndRandomWalk();
    RestoreButtons();
}

LRESULT MainWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    const HINSTANCE instance = WindowInstance(window);
    switch (message) {
    case WM_CREATE:
        OpenMainWindow(window, instance);
        return 0;
    case WM_DESTROY:
        CloseMainWindow();
        return 0;
    case WM_SIZE:
        PlaceInMainWindow(window);
        return 0;
    case WM_ACTIVATE:
        ActivateMainWindow(window, wParam);
        return 0;
    case WM_PAINT:
        PaintChrome(window);
        return 0;
    case WM_CLOSE:
        DestroyWindow(window);
        return 0;
    case WM_DRAWITEM:
        DrawSysButton(reinterpret_cast<const DRAWITEMSTRUCT*>(lParam));
        return 1;
    case WM_NCHITTEST:
        return ChromeHitTest(window, lParam);
    case WM_COMMAND:
        EditorCommand(window, instance, wParam, lParam);
        return 0;
    case WM_TIMER:
        KillTimer(window, TIMER_OPENING);
        StartOpeningWalk(EditorStage);
        return 0;
    case TM_BACKGROUND:
        ShowNewBackdrop(window, instance);
        return 0;
    case TM_ENABLEPLAY:
        EnableWindow(PlayButton, wParam != 0 ? TRUE : FALSE);
        return 0;
    case TM_EDITORCLOSED:
        LeaveFrameEditor();
        return 0;
    default:
        return DefWindowProcA(window, message, wParam, lParam);
    }
}

// ---- The stage ----------------------------------------------------------------------------------

static void CloseStage() {
    Trace("close");
    ReleaseStageArt();
    EditorStage = nullptr;
    PostQuitMessage(0);
}

static LRESULT ClickStage(HWND stage, HINSTANCE instance, LPARAM point) {
    if (CharacterArtLoaded == 0) {
        LoadCharacterArt(stage, instance);
    }
    return StageClick(stage, point);
}

LRESULT StageWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    const HINSTANCE instance = WindowInstance(window);
    switch (message) {
    case WM_DESTROY:
        CloseStage();
        return 0;
    case WM_SIZE:
        EditorRepaintFlag = 1;
        return ResizeStage(window);
    case WM_PAINT:
        return PaintStage(window, &EditorRepaintFlag);
    case WM_CLOSE:
        DestroyWindow(EditorMainWindow);
        return 0;
    case WM_TIMER:
        StageTimerDispatch(window, wParam);
        return 0;
    case WM_LBUTTONDOWN:
        return ClickStage(window, instance, lParam);
    case TM_SHOWDONE:
        return 0; // nothing follows a show by itself
    case TM_WALKDONE:
        DrawProgress(GetParent(window));
        WalkDoneDispatch(window);
        return 0;
    default:
        return DefWindowProcA(window, message, wParam, lParam);
    }
}

// ---- The about box ------------------------------------------------------------------------------

LRESULT AboutProc(HWND dialog, UINT message, WPARAM wParam, LPARAM /*lParam*/) {
    switch (message) {
    case WM_INITDIALOG:
        CentreDialog(dialog);
        return 1;
    case WM_COMMAND:
        // Meant: Escape and the close box, which send IDCANCEL, do nothing.
        if (LOWORD(static_cast<DWORD>(wParam)) == IDOK) {
            EndDialog(dialog, 1);
            return 1;
        }
        return 0;
    default:
        return 0;
    }
}

#include "saver/show_cycle.h"

#include "platform/drawing_kit.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "saver/saver_guard.h"
#include "stage/backdrop.h"
#include "stage/character.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/stage.h"
#include "stage/walk.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

#include <cstring>

char NextToonFile[NEXT_TOON_SIZE];
LONG ToonFileCount;
LONG BackgroundCount;
LONG LastBackground;
DWORD StageRepaintFlag = 1;

static DWORD SavedStageSize; // StageSize as it was before ShowSetup

constexpr UINT SHOWSTART_MS = 2000;
constexpr int TITLE_STRING = 2;
constexpr LONG STYLE_TOONS = 1;
constexpr int DRAW_TRIES = 100;

constexpr const char* TOON_PATTERN = "*.zkt";
constexpr const char* INTRO_TOON = "intro.zkt";
constexpr const char* FONT_FACE = "MS Serif";
constexpr int TITLE_HEIGHT = 32;
constexpr int TITLE_WEIGHT = 700;
constexpr int BYLINE_HEIGHT = 20;
constexpr int BYLINE_WEIGHT = 400;

// ---- The stage ---------------------------------------------------------------------------------

void ShowSetup(HWND window, HINSTANCE instance) {
    StageBegin();
    SavedStageSize = StageSize;
    SaverActive = 1;
    OpeningDone = 0;
    TitleShown = 0;
    BackgroundIndex = 0;
    LoadStringA(instance, TITLE_STRING, StageTitle, sizeof StageTitle);
    SettingsLoad();
    RECT client{};
    GetClientRect(window, &client);
    SeedRandom(WallClockSeconds());
    LoadExpressionSheet(instance);
    TitleFont = MakeFont(TITLE_HEIGHT, TITLE_WEIGHT, FONT_FACE);
    BylineFont = MakeFont(BYLINE_HEIGHT, BYLINE_WEIGHT, FONT_FACE);
    StageSize = MAKELONG(client.right, client.bottom);
    if (CharacterArtLoaded == 0) {
        LoadCharacterArt(window, instance);
    }
    ShowReset(window);
    RebuildBackdrop(window, instance);
    SetTimer(window, TIMER_SHOWSTART, SHOWSTART_MS, nullptr);
    if (PreviewMode != PREVIEW_WALK) {
        ShowCursor(FALSE);
    }
}

void ShowTeardown(HWND window) {
    Trace("close");
    StopWalkTimer(window);
    SaverActive = 0;
    StageSize = SavedStageSize;
    FrameStoreFree();
    FreeExpressionSheet();
    DeleteObject(BylineFont);
    BylineFont = nullptr;
    DeleteObject(TitleFont);
    TitleFont = nullptr;
    ReleaseStageArt();
    OpeningDone = 0;
    TitleShown = 0;
    SettingsSave();
    if (PreviewMode != PREVIEW_WALK) {
        ShowCursor(TRUE);
    }
}

void ShowReset(HWND window) {
    CurrentFrameIndex = 0;
    NextFrameIndex = 0;
    ResetShow(window);
}

// ---- The choice --------------------------------------------------------------------------------

/// Goes on to the first entry whose name NextToonFile holds: a name that is cut would be that of
/// another file. `more` tells whether `entry` holds one to begin with.
static BOOL SkipLongNames(HANDLE scan, WIN32_FIND_DATAA* entry, BOOL more) {
    while (more && std::strlen(entry->cFileName) >= NEXT_TOON_SIZE) {
        more = FindNextFileA(scan, entry);
    }
    return more;
}

static HANDLE FindFirstToon(WIN32_FIND_DATAA* entry) {
    const HANDLE scan = FindFirstFileA(TOON_PATTERN, entry);
    if (scan != INVALID_HANDLE_VALUE && !SkipLongNames(scan, entry, TRUE)) {
        FindClose(scan);
        return INVALID_HANDLE_VALUE;
    }
    return scan;
}

static BOOL FindNextToon(HANDLE scan, WIN32_FIND_DATAA* entry) {
    WIN32_FIND_DATAA next{};
    const BOOL found = SkipLongNames(scan, &next, FindNextFileA(scan, &next));
    if (found) {
        *entry = next;
    }
    return found;
}

LONG CountToonFiles() {
    // Meant: whatever has such a name counts, a directory too; its load fails like that of any bad
    // file.
    WIN32_FIND_DATAA entry{};
    ToonFileCount = 0;
    const HANDLE scan = FindFirstToon(&entry);
    if (scan == INVALID_HANDLE_VALUE) {
        return 0;
    }
    do {
        ++ToonFileCount;
    } while (FindNextToon(scan, &entry));
    FindClose(scan);
    return ToonFileCount;
}

int PickRandomToonFile(char* name) {
    if (ToonFileCount == 0) {
        return 0;
    }
    const LONG pick = ToonFileCount >= 2 ? RandomInt(1, ToonFileCount) : 1;
    WIN32_FIND_DATAA entry{};
    const HANDLE scan = FindFirstToon(&entry);
    if (scan == INVALID_HANDLE_VALUE) {
        return 0;
    }
    for (LONG i = 1; i < pick; ++i) {
        FindNextToon(scan, &entry); // in a directory that has shrunk the last entry stands
    }
    FindClose(scan);
    CopyText(name, entry.cFileName, NEXT_TOON_SIZE);
    return 1;
}

int PickIntroToon() {
    if (PacesWalked != 0) {
        return 0;
    }
    WIN32_FIND_DATAA entry{};
    const HANDLE scan = FindFirstFileA(INTRO_TOON, &entry);
    if (scan == INVALID_HANDLE_VALUE) {
        return 0;
    }
    FindClose(scan);
    CopyText(NextToonFile, entry.cFileName, NEXT_TOON_SIZE);
    return 1;
}

int PickToonFile() {
    if (ToonFileCount < 1) {
        return 0;
    }
    if (PickIntroToon()) {
        return 1;
    }
    char name[NEXT_TOON_SIZE] = "";
    if (!PickRandomToonFile(name)) {
        return 0;
    }
    for (int i = 1; i < DRAW_TRIES && ToonFileCount >= 2 && std::strcmp(name, NextToonFile) == 0;
         ++i) {
        PickRandomToonFile(name);
    }
    CopyText(NextToonFile, name, NEXT_TOON_SIZE);
    return 1;
}

static BOOL BackgroundExists(HINSTANCE instance, LONG number) {
    char name[TILE_NAME_SIZE];
    TileName(name, number);
    return FindResourceA(instance, name, RT_BITMAP) ? TRUE : FALSE;
}

void CountBackgrounds(HWND window) {
    const HINSTANCE instance = WindowInstance(window);
    BackgroundCount = 0;
    while (BackgroundExists(instance, BackgroundCount + 1)) {
        ++BackgroundCount;
    }
}

void PickBackground(HWND window) {
    if (Backgrounds == 0) {
        return;
    }
    if (BackgroundCount == 0) {
        CountBackgrounds(window);
    }
    if (BackgroundCount < 2) {
        return;
    }
    LONG pick = RandomInt(1, BackgroundCount);
    while (pick == LastBackground) {
        pick = RandomInt(1, BackgroundCount);
    }
    BackgroundIndex = pick;
    LastBackground = pick;
}

void ChooseNextShow(HWND window) {
    if (WalkingStyle == STYLE_TOONS) {
        // Meant: these two changes are saved as the user's choice when the stage ends.
        Backgrounds = 1;
        PickToonFile();
        if (NextToonFile[0] == '\0') {
            WalkingStyle = 0;
        }
    } else {
        PickBackground(window);
    }
    Trace("choice file=%s", NextToonFile);
}

// ---- The show ----------------------------------------------------------------------------------

static void Repaint(HWND window) {
    Trace("invalidate");
    InvalidateRect(window, nullptr, FALSE);
}

static void StartWalkAbout(HWND window, HINSTANCE instance) {
    if (Backgrounds != 0) {
        RebuildBackdrop(window, instance);
    }
    Repaint(window);
    PickRandomWalk(window, static_cast<DWORD>(Statements));
}

static void StartToon(HWND window, HINSTANCE instance) {
    if (ToonOpenNamed(window, NextToonFile)) {
        PlayNextFrame(window);
        RebuildBackdrop(window, instance);
        Repaint(window);
    } else if (PreviewMode == PREVIEW_WHOLE) {
        StartWalkAbout(window, instance); // nobody is asked there, and no key comes to end it
    }
}

void StartNextShow(HWND window, HINSTANCE instance) {
    if (PreviewMode == PREVIEW_WALK) {
        StartPreviewWalk(window);
    } else if (NextToonFile[0] != '\0') {
        StartToon(window, instance);
    } else {
        StartWalkAbout(window, instance);
    }
}

static LRESULT OnCreate(HWND window, HINSTANCE instance) {
    ShowSetup(window, instance);
    SetCurrentDirectoryA(Directory);
    if (WalkingStyle == STYLE_TOONS) {
        CountToonFiles();
    }
    NextToonFile[0] = '\0';
    ChooseNextShow(window);
    return 0;
}

LRESULT ShowTimer(HWND window, HINSTANCE instance, UINT_PTR timer) {
    if (timer == TIMER_SHOWSTART) {
        KillTimer(window, TIMER_SHOWSTART);
        StartNextShow(window, instance);
    } else {
        StageTimerDispatch(window, timer);
    }
    return 0;
}

LRESULT ShowResize(HWND window, HINSTANCE instance, DWORD size) {
    if (size != StageSize) {
        StageSize = size;
        RebuildBackdrop(window, instance);
        StageRepaintFlag = 1;
        InvalidateRect(window, nullptr, FALSE);
    }
    return 0;
}

static LRESULT OnShowDone(HWND window, HINSTANCE instance) {
    ShowReset(window);
    ChooseNextShow(window);
    StartNextShow(window, instance);
    return 0;
}

LRESULT ShowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    const HINSTANCE instance = WindowInstance(window);
    switch (message) {
    case WM_CREATE:
        return OnCreate(window, instance);
    case WM_DESTROY:
        ShowTeardown(window);
        PostQuitMessage(0);
        return 0;
    case WM_SIZE:
        return ShowResize(window, instance, static_cast<DWORD>(lParam));
    case WM_PAINT:
        PaintStage(window, &StageRepaintFlag);
        return 0;
    case WM_ERASEBKGND:
        return 1;
    case WM_TIMER:
        return ShowTimer(window, instance, wParam);
    case TM_SHOWDONE:
        return OnShowDone(window, instance);
    case TM_WALKDONE:
        WalkDoneDispatch(window);
        return 0;
    default:
        return SaverDefaultProc(window, message, wParam, lParam);
    }
}

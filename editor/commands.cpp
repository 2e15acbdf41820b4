#include "editor/commands.h"

#include "editor/button_states.h"
#include "editor/chrome.h"
#include "editor/command_ids.h"
#include "editor/editor_shell.h"
#include "editor/frame_editor.h"
#include "platform/menus.h"
#include "stage/play_command.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "toon/toon_document.h"
#include "toon/toon_prompts.h"

static HMENU FilePopup;

constexpr DWORD STATEMENTS_ALLOWED = 1;

// ---- Commands -----------------------------------------------------------------------------------

/// A show that is under way ends where the frames that it plays have gone.
static void OpenToon(HWND mainWindow) {
    const HGLOBAL before = FrameStore;
    ToonOpenFromMenu(mainWindow);
    if (FrameStore != before) {
        EndShow();
    }
}

static void WalkAbout() {
    PickRandomWalk(EditorStage, STATEMENTS_ALLOWED);
}

static void CloseEditor(HWND mainWindow) {
    SuspendPlayback(EditorStage);
    DestroyWindow(mainWindow);
}

/// 1 if `control` is one of the five buttons, whose command has then run, else 0.
static int ControlCommand(HWND mainWindow, LPARAM control, HINSTANCE instance) {
    const HWND sender{static_cast<DWORD>(control)};
    if (!sender) {
        return 0;
    }
    if (sender == FileButton) {
        ShowFilePopup(mainWindow);
    } else if (sender == PlayButton) {
        PlayCommand(mainWindow, instance);
    } else if (sender == WalkButton) {
        WalkAbout();
    } else if (sender == MinimizeButton) {
        ShowWindow(mainWindow, SW_MINIMIZE);
    } else if (sender == CloseButton) {
        CloseEditor(mainWindow);
    } else {
        return 0;
    }
    return 1;
}

/// The button that a key stands for; null for a key that means nothing in the main window.
static HWND ButtonOfKey(int key) {
    switch (key) {
    case KEY_FILE:
    case KEY_OPEN:
    case KEY_EDIT:
        return FileButton;
    case KEY_PLAY:
    case KEY_CONTINUE:
    case KEY_STOP:
        return PlayButton;
    case KEY_WALK:
        return WalkButton;
    default:
        return nullptr;
    }
}

/// 1 if this is a key that means something now; its command runs if the button that stands for it
/// is enabled. Else 0.
static int AcceleratorCommand(HWND mainWindow, WPARAM wParam, HINSTANCE instance) {
    const int key = LOWORD(static_cast<DWORD>(wParam));
    if (EditorDialog) {
        return FrameEditorAccelerator(instance, key);
    }
    const HWND button = ButtonOfKey(key);
    if (!button) {
        return 0;
    }
    if (!IsWindowEnabled(button)) {
        return 1;
    }
    switch (key) {
    case KEY_FILE:
        ShowFilePopup(mainWindow);
        break;
    case KEY_OPEN:
        OpenToon(mainWindow);
        break;
    case KEY_EDIT:
        OpenFrameEditor(mainWindow, instance);
        break;
    case KEY_WALK:
        WalkAbout();
        break;
    default: // Play, Continue and Stop are one, whatever the button reads
        PlayCommand(mainWindow, instance);
        break;
    }
    return 1;
}

static void PopupCommand(HWND mainWindow, WPARAM wParam, HINSTANCE instance) {
    switch (LOWORD(static_cast<DWORD>(wParam))) {
    case POPUP_OPEN:
        OpenToon(mainWindow);
        break;
    case POPUP_EDIT:
        OpenFrameEditor(mainWindow, instance);
        break;
    case POPUP_PLAY:
        PlayCommand(mainWindow, instance);
        break;
    case POPUP_ABOUT:
        DialogBoxParamA(instance, "About", mainWindow, AboutProc, 0);
        break;
    case POPUP_EXIT:
        DestroyWindow(mainWindow);
        break;
    default:
        break;
    }
}

void EditorCommand(HWND mainWindow, HINSTANCE instance, WPARAM wParam, LPARAM lParam) {
    if (ControlCommand(mainWindow, lParam, instance) == 0 &&
        AcceleratorCommand(mainWindow, wParam, instance) == 0) {
        PopupCommand(mainWindow, wParam, instance);
    }
}

// ---- The menu -----------------------------------------------------------------------------------

void CreateFilePopup() {
    FilePopup = CreatePopupMenu();
    AppendMenuA(FilePopup, MF_STRING, POPUP_OPEN, "&Open..\tCtrl+O");
    AppendMenuA(FilePopup, MF_STRING, POPUP_EDIT, "&Edit..\tCtrl+E");
    AppendMenuA(FilePopup, MF_STRING, POPUP_PLAY, "&Play\tAlt+P");
    AppendMenuA(FilePopup, MF_SEPARATOR, 0, nullptr);
    AppendMenuA(FilePopup, MF_STRING, POPUP_ABOUT, "&About..");
    AppendMenuA(FilePopup, MF_STRING, POPUP_EXIT, "E&xit");
}

void DestroyFilePopup() {
    if (FilePopup) {
        DestroyMenu(FilePopup);
        FilePopup = nullptr;
    }
}

/// An estimate: a line of the system's font for each item.
static LONG MenuHeight(HWND mainWindow) {
    const HDC dc = GetDC(mainWindow);
    const HGDIOBJ font = SelectObject(dc, GetStockObject(SYSTEM_FONT));
    TEXTMETRICA metrics{};
    GetTextMetricsA(dc, &metrics);
    SelectObject(dc, font);
    ReleaseDC(mainWindow, dc);
    return GetMenuItemCount(FilePopup) * metrics.tmHeight;
}

void ShowFilePopup(HWND mainWindow) {
    constexpr LONG fromLeft = 11; // of the window: the File button's left edge
    constexpr LONG fromBottom = 44;
    RECT place{};
    GetWindowRect(mainWindow, &place);
    const LONG height = MenuHeight(mainWindow);
    const UINT play = IsWindowEnabled(PlayButton) ? MF_ENABLED : MF_GRAYED;
    const UINT open = EditorDialog ? MF_GRAYED : MF_ENABLED;
    EnableMenuItem(FilePopup, POPUP_PLAY, play);
    EnableMenuItem(FilePopup, POPUP_OPEN, open);
    EnableMenuItem(FilePopup, POPUP_EDIT, open);
    TrackPopupMenu(FilePopup, 0, place.left + fromLeft, place.bottom - height - fromBottom, 0,
                   mainWindow, nullptr);
}

#include "editor/configuration.h"

#include "editor/editor_shell.h"
#include "platform/drawing_kit.h"
#include "platform/kernel.h"
#include "stage/backdrop.h"
#include "toon/toon_prompts.h"

static DWORD BackgroundItemCount;

constexpr int CAPTION_FIELD = 1023;
constexpr int WIDTH_LABEL = 1024;
constexpr int HEIGHT_LABEL = 1025;
constexpr int FRAMES_LABEL = 1029;
constexpr int SPEED_BAR = 1030;
constexpr int BACKGROUND_LIST = 1035;

constexpr WPARAM CAPTION_LIMIT = 49; // characters that can be typed
constexpr int CAPTION_READ = 49;     // bytes that are read back, the NUL included
constexpr int SLOWEST = 1;
constexpr int FASTEST = 5;
constexpr UINT ITEM_HEIGHT = 35; // pixels of the list

int ConfigureToon(HINSTANCE instance, HWND editorDialog) {
    DialogBoxParamA(instance, "Configure", editorDialog, ConfigureProc, 0);
    SendMessageA(GetParent(editorDialog), TM_BACKGROUND, 0, 0);
    return 1;
}

// ---- The background -----------------------------------------------------------------------------

static LRESULT TellList(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) {
    return SendDlgItemMessageA(dialog, BACKGROUND_LIST, message, wParam, lParam);
}

void FillBackgroundList(HWND dialog) {
    const HINSTANCE instance = WindowInstance(dialog);
    TellList(dialog, CB_RESETCONTENT, 0, 0);
    char name[TILE_NAME_SIZE];
    LONG number = 1;
    for (TileName(name, number); FindResourceA(instance, name, RT_BITMAP); TileName(name, number)) {
        TellList(dialog, CB_ADDSTRING, 0, LPARAM{LoadBitmapA(instance, name).number});
        ++number;
    }
    BackgroundItemCount = static_cast<DWORD>(number - 1);
    TellList(dialog, CB_SETCURSEL, static_cast<WPARAM>(BackgroundIndex) - 1, 0);
}

static HBITMAP BitmapOf(std::uintptr_t itemData) {
    return HBITMAP{HGDIOBJ{static_cast<DWORD>(itemData)}};
}

void FreeBackgroundList(HWND dialog) {
    for (DWORD item = 0; item < BackgroundItemCount; ++item) {
        const LRESULT value = TellList(dialog, CB_GETITEMDATA, item, 0);
        if (value != 0) {
            DeleteObject(BitmapOf(static_cast<std::uintptr_t>(value)));
        }
    }
    BackgroundItemCount = 0;
}

/// Meant: neither the selected item nor the focus is marked.
static void DrawBackgroundItem(const DRAWITEMSTRUCT* item) {
    if (item->itemAction == ODA_DRAWENTIRE) {
        RECT place = item->rcItem;
        InflateRect(&place, -4, -2);
        BlitPicture(item->hDC, place.left, place.top, place.right, place.bottom,
                    BitmapOf(item->itemData));
    }
}

// ---- The speed ----------------------------------------------------------------------------------

/// A page is one step, like a line. Meant: a dragged thumb goes back to its place.
static void MoveSpeed(HWND dialog, WORD code) {
    const HWND bar = GetDlgItem(dialog, SPEED_BAR);
    const int speed = GetScrollPos(bar, SB_CTL);
    const bool slower = code == SB_LINEUP || code == SB_PAGEUP;
    const bool faster = code == SB_LINEDOWN || code == SB_PAGEDOWN;
    if (slower && speed > SLOWEST) {
        SetScrollPos(bar, SB_CTL, speed - 1, TRUE);
    } else if (faster && speed < FASTEST) {
        SetScrollPos(bar, SB_CTL, speed + 1, TRUE);
    }
}

// ---- The dialog ---------------------------------------------------------------------------------

int ConfigureInit(HWND dialog, const ToonHeader* header) {
    CentreDialog(dialog);
    char title[TOON_MAGIC_SIZE];
    CopyText(title, header->magic, sizeof title);
    SendMessageA(dialog, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(title));
    SetDlgItemInt(dialog, FRAMES_LABEL, static_cast<UINT>(FrameCount), TRUE);
    SendDlgItemMessageA(dialog, CAPTION_FIELD, EM_LIMITTEXT, CAPTION_LIMIT, 0);
    char caption[TOON_CAPTION_SIZE];
    CopyText(caption, header->caption, sizeof caption);
    SetDlgItemTextA(dialog, CAPTION_FIELD, caption);
    SetDlgItemInt(dialog, WIDTH_LABEL, LOWORD(header->windowSize), TRUE);
    SetDlgItemInt(dialog, HEIGHT_LABEL, HIWORD(header->windowSize), TRUE);
    FillBackgroundList(dialog);
    const HWND bar = GetDlgItem(dialog, SPEED_BAR);
    SetScrollRange(bar, SB_CTL, SLOWEST, FASTEST, FALSE);
    SetScrollPos(bar, SB_CTL, header->speed, TRUE);
    return 1;
}

int ConfigureCommit(HWND dialog, ToonHeader* header) {
    GetDlgItemTextA(dialog, CAPTION_FIELD, header->caption, CAPTION_READ);
    BackgroundIndex = static_cast<LONG>(TellList(dialog, CB_GETCURSEL, 0, 0)) + 1;
    header->background = BackgroundIndex;
    CopyText(CaptionText, header->caption, TOON_CAPTION_SIZE);
    ToonSpeed = GetScrollPos(GetDlgItem(dialog, SPEED_BAR), SB_CTL);
    header->speed = ToonSpeed;
    ToonSetDirty(GetParent(dialog), 1);
    return 1;
}

static LRESULT ConfigureCommand(HWND dialog, int command) {
    if (command != IDOK && command != IDCANCEL) {
        return 0;
    }
    if (command == IDOK) {
        ConfigureCommit(dialog, &ToonDocHeader);
    }
    FreeBackgroundList(dialog);
    EndDialog(dialog, 1);
    return 1;
}

LRESULT ConfigureProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_INITDIALOG:
        return ConfigureInit(dialog, &ToonDocHeader);
    case WM_DESTROY:
        FreeBackgroundList(dialog); // it may go with the editor
        return 0;
    case WM_COMMAND:
        return ConfigureCommand(dialog, LOWORD(static_cast<DWORD>(wParam)));
    case WM_HSCROLL:
        MoveSpeed(dialog, LOWORD(static_cast<DWORD>(wParam)));
        return 0;
    case WM_MEASUREITEM:
        reinterpret_cast<MEASUREITEMSTRUCT*>(lParam)->itemHeight = ITEM_HEIGHT;
        return 0;
    case WM_DRAWITEM:
        DrawBackgroundItem(reinterpret_cast<const DRAWITEMSTRUCT*>(lParam));
        return 0;
    default:
        return 0;
    }
}

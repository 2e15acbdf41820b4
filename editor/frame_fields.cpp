#include "editor/frame_fields.h"

#include "editor/command_ids.h"
#include "platform/kernel.h"
#include "stage/editor_host.h"

#include <algorithm>
#include <cstring>

LONG EditPose;

constexpr LONG BEYOND_STAGE = 150; // how far off the screen he may stand
constexpr LONG DEFAULT_PAUSE = 5;  // seconds
constexpr LONG LONGEST_PAUSE = 20;

// ---- The list -----------------------------------------------------------------------------------

static LRESULT TellList(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) {
    return SendDlgItemMessageA(dialog, FRAME_LIST, message, wParam, lParam);
}

void FillFrameList(HWND dialog) {
    TellList(dialog, CB_RESETCONTENT, 0, 0);
    for (LONG number = 1; number <= FrameCount; ++number) {
        AddFrameListItem(dialog, number);
    }
    TellList(dialog, CB_SETEXTENDEDUI, 1, 0);
    SelectListedFrame(dialog, CurrentFrameIndex);
}

void AddFrameListItem(HWND dialog, LONG number) {
    char text[16];
    wsprintfA(text, "%d", number);
    TellList(dialog, CB_INSERTSTRING, static_cast<WPARAM>(number - 1),
             reinterpret_cast<LPARAM>(text));
}

void SelectListedFrame(HWND dialog, LONG index) {
    TellList(dialog, CB_SETCURSEL, static_cast<WPARAM>(index), 0);
}

LONG FrameListSelection(HWND dialog) {
    return static_cast<LONG>(TellList(dialog, CB_GETCURSEL, 0, 0));
}

int SelectFrame(HWND dialog) {
    const LONG selected = FrameListSelection(dialog);
    if (selected < 0) {
        return 0;
    }
    CurrentFrameIndex = selected;
    return ShowCurrentFrame(dialog);
}

int FrameSelectionChanged(HWND dialog) {
    return FrameListSelection(dialog) == CurrentFrameIndex ? 1 : SelectFrame(dialog);
}

// ---- The fields ---------------------------------------------------------------------------------

static void ShowNumber(HWND dialog, int field, LONG number) {
    SetDlgItemInt(dialog, field, static_cast<UINT>(number), TRUE);
}

static LONG ReadNumber(HWND dialog, int field) {
    return static_cast<LONG>(GetDlgItemInt(dialog, field, nullptr, TRUE));
}

int ShowFrameFields(HWND dialog, const ToonFrame* frame) {
    SetDlgItemTextA(dialog, TEXT_FIELD, frame->text);
    ShowNumber(dialog, X_FIELD, frame->x);
    ShowNumber(dialog, Y_FIELD, frame->y);
    ShowNumber(dialog, PAUSE_FIELD, frame->pause);
    SendDlgItemMessageA(dialog, TEXT_FIELD, EM_LIMITTEXT, TOON_TEXT_SIZE - 1, 0);
    CheckDlgButton(dialog, WINK_CHECK, frame->wink != 0 ? 1 : 0);
    ShowPoseLabel(dialog, frame->pose);
    EditPose = frame->pose;
    ShowEditorTitle(dialog);
    return 1;
}

int ShowCurrentFrame(HWND dialog) {
    return FrameGet(CurrentFrameIndex, &EditFrame) == 0 ? 0 : ShowFrameFields(dialog, &EditFrame);
}

/// Copies the name of a file without drive, directory and extension, in lower case.
static void BaseName(char* name, const char* path) {
    const bool drive = path[0] != '\0' && path[1] == ':';
    const char* start = drive ? path + 2 : path;
    for (const char* at = start; *at != '\0'; ++at) {
        start = *at == '\\' || *at == '/' ? at + 1 : start;
    }
    const char* dot = std::strrchr(start, '.');
    const std::size_t length =
        dot != nullptr ? static_cast<std::size_t>(dot - start) : std::strlen(start);
    std::memcpy(name, start, length);
    name[length] = '\0';
    CharLowerA(name);
}

void ShowEditorTitle(HWND dialog) {
    char title[TOON_PATH_SIZE + 16];
    char name[TOON_PATH_SIZE] = "Untitled";
    if (ToonFileName[0] != '\0') {
        BaseName(name, ToonFileName);
    }
    wsprintfA(title, "File: [%s]", name);
    SendMessageA(dialog, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(title));
}

void ShowPoseLabel(HWND dialog, LONG pose) {
    char label[32];
    const DWORD number = static_cast<DWORD>(pose) + 1; // a file may hold any
    wsprintfA(label, "Frame P&ose = %d", static_cast<LONG>(number));
    SetDlgItemTextA(dialog, POSE_BUTTON, label);
}

/// Meant: 0, and so an empty field, stands for the middle of the stage; the range is the screen's.
static LONG ReadPlace(HWND dialog, int field, LONG stageSize, int screenSize) {
    const LONG typed = ReadNumber(dialog, field);
    return std::clamp<LONG>(typed == 0 ? stageSize / 2 : typed, -BEYOND_STAGE,
                            GetSystemMetrics(screenSize) + BEYOND_STAGE);
}

int ReadFrameFields(HWND dialog, ToonFrame* frame) {
    GetDlgItemTextA(dialog, TEXT_FIELD, frame->text, TOON_TEXT_SIZE);
    frame->x = ReadPlace(dialog, X_FIELD, LOWORD(StageSize), SM_CXSCREEN);
    frame->y = ReadPlace(dialog, Y_FIELD, HIWORD(StageSize), SM_CYSCREEN);
    const LONG pause = ReadNumber(dialog, PAUSE_FIELD);
    frame->pause = std::clamp<LONG>(pause == 0 ? DEFAULT_PAUSE : pause, 1, LONGEST_PAUSE);
    frame->wink = static_cast<LONG>(IsDlgButtonChecked(dialog, WINK_CHECK));
    frame->pose = EditPose;
    return FramePut(CurrentFrameIndex, frame);
}

int CommitFrame(HWND dialog) {
    const LONG selected = FrameListSelection(dialog);
    if (selected < 0) {
        return 0;
    }
    CurrentFrameIndex = selected;
    const int done = ReadFrameFields(dialog, &EditFrame);
    if (done != 0) {
        ToonSetDirty(dialog, 1);
    }
    return done;
}

void FrameFromClick(LONG x, LONG y) {
    if (!EditorDialog || CommitFrame(EditorDialog) == 0) {
        return;
    }
    EditFrame.x = x;
    EditFrame.y = y;
    FramePut(CurrentFrameIndex, &EditFrame);
    ShowNumber(EditorDialog, X_FIELD, x);
    ShowNumber(EditorDialog, Y_FIELD, y);
}

#include "editor/pose_picker.h"

#include "platform/drawing_kit.h"
#include "platform/kernel.h"
#include "stage/sprite.h"
#include "stage/window_loop.h"

#include <algorithm>

static HINSTANCE PoseClassInstance;
static HWND PoseWindow;
static LONG PickedPose;

constexpr int POSES = 8;
constexpr int COLUMNS = 4;
static HBITMAP PosePictures[POSES];

constexpr const char* POSE_CLASS = "PoseWndClass";
constexpr COLORREF NUMBER_COLOUR = RGB(0, 0, 255);

// ---- Pictures and places ------------------------------------------------------------------------

static void LoadPosePictures(HINSTANCE instance) {
    for (int pose = 0; pose < POSES; ++pose) {
        char name[16];
        wsprintfA(name, "pose0%d", pose + 1);
        PosePictures[pose] = LoadBitmapA(instance, name);
    }
}

static void FreePosePictures() {
    for (HBITMAP& picture : PosePictures) {
        DeleteObject(picture);
        picture = nullptr;
    }
}

/// Of one picture; they are all alike.
static SIZE PictureSize() {
    BITMAP record{};
    GetObjectA(PosePictures[0], sizeof record, &record);
    return {record.bmWidth, record.bmHeight};
}

/// Two pixels part the columns and three the rows.
static RECT PoseCell(int pose) {
    constexpr LONG margin = 5;
    constexpr LONG rim = 8; // of both sides
    const SIZE picture = PictureSize();
    const LONG left = margin + pose % COLUMNS * (picture.cx + 10);
    const LONG top = pose < COLUMNS ? margin : picture.cy + 16;
    return {left, top, left + picture.cx + rim, top + picture.cy + rim};
}

static void SizePoseWindow(HWND window) {
    const SIZE picture = PictureSize();
    const int width = 4 * picture.cx + 50;
    const int height = 2 * picture.cy + 30;
    MoveWindow(window, (GetSystemMetrics(SM_CXSCREEN) - width) / 2,
               (GetSystemMetrics(SM_CYSCREEN) - height) / 2, width, height, TRUE);
}

static void ClipToPoseWindow(HWND window) {
    RECT place{};
    GetWindowRect(window, &place);
    ClipCursor(&place);
}

// ---- Painting -----------------------------------------------------------------------------------

static void BevelCell(HDC dc, const RECT& cell, int width) {
    DrawBevel(dc, cell.left, cell.top, cell.right, cell.bottom, width);
}

static void DrawPoseNumber(HDC dc, LONG x, LONG y, int number) {
    char text[16];
    wsprintfA(text, "%d", number);
    DrawShadowText(dc, NUMBER_COLOUR, text, x, y + 5, x + 30, y + 40, 1);
}

constexpr int RAISED = -3;
constexpr int SUNKEN = 3;
constexpr LONG PICTURE_IN_CELL = 3;

static void DrawPose(HDC dc, int pose) {
    const RECT cell = PoseCell(pose);
    const LONG x = cell.left + PICTURE_IN_CELL;
    const LONG y = cell.top + PICTURE_IN_CELL;
    BevelCell(dc, cell, pose == PickedPose ? SUNKEN : RAISED);
    SpriteStampOnce(dc, PosePictures[pose], x, y);
    DrawPoseNumber(dc, x, y, pose + 1);
}

static void PaintPoseGrid(HDC dc, HWND window) {
    const int mapMode = SetMapMode(dc, MM_TEXT);
    const HFONT numbers = MakeFont(16, FW_NORMAL, "MS Serif");
    const HGDIOBJ font = SelectObject(dc, numbers);
    RECT client{};
    GetClientRect(window, &client);
    DrawBevel(dc, client.left, client.top, client.right, client.bottom, -2);
    PickedPose = std::clamp<LONG>(PickedPose, 0, POSES - 1);
    for (int pose = 0; pose < POSES; ++pose) {
        DrawPose(dc, pose);
    }
    SelectObject(dc, font);
    SetMapMode(dc, mapMode);
    DeleteObject(numbers);
}

static void PaintPoseWindow(HWND window) {
    PAINTSTRUCT paint{};
    const HDC dc = BeginPaint(window, &paint);
    SaveDC(dc);
    PaintPoseGrid(dc, window);
    RestoreDC(dc, -1);
    EndPaint(window, &paint);
}

// ---- The choice ---------------------------------------------------------------------------------

/// Meant: a press beside all cells chooses the first pose.
static void PickPoseAt(HWND window, LPARAM point) {
    const auto packed = static_cast<DWORD>(point);
    const POINT at{LOWORD(packed), HIWORD(packed)};
    const HDC dc = GetDC(window);
    LONG chosen = 0;
    for (int pose = 0; pose < POSES; ++pose) {
        const RECT cell = PoseCell(pose);
        if (pose == PickedPose) {
            BevelCell(dc, cell, RAISED);
        }
        if (PtInRect(&cell, at)) {
            chosen = pose;
            BevelCell(dc, cell, SUNKEN);
        }
    }
    ReleaseDC(window, dc);
    PickedPose = chosen;
}

static void PoseKey(HWND window, WPARAM key) {
    constexpr WPARAM firstKey = '1';
    if (key >= firstKey && key < firstKey + POSES) {
        PickedPose = static_cast<LONG>(key - firstKey);
        SendMessageA(window, WM_CLOSE, 0, 0);
    }
}

// ---- The window ---------------------------------------------------------------------------------

int PoseClassSetup(HINSTANCE instance) {
    PoseClassInstance = instance;
    return RegisterGreyClass(POSE_CLASS, PoseWindowProc, instance,
                             LoadIconA(nullptr, IDI_APPLICATION));
}

int CreatePoseWindow(HINSTANCE instance, HWND owner) {
    PoseWindow = CreateWindowExA(0, POSE_CLASS, nullptr, WS_POPUP | WS_BORDER, 0, 0, 0, 0, owner,
                                 nullptr, instance, nullptr);
    if (!PoseWindow) {
        return 0;
    }
    SetWindowTextA(PoseWindow, "Choose a Pose, 1 to 8"); // for lists of windows: it shows no title
    ShowWindow(PoseWindow, SW_SHOWNORMAL);
    UpdateWindow(PoseWindow);
    return 1;
}

LONG RunPosePicker(HINSTANCE instance, HWND owner, LONG currentPose) {
    if (PoseWindow) {
        return currentPose; // the owner still takes keys; one picker at a time
    }
    PickedPose = currentPose;
    if (!PoseClassInstance && !PoseClassSetup(instance)) {
        return 0;
    }
    if (!CreatePoseWindow(instance, owner)) {
        return 0;
    }
    return RunWindowLoop(PoseWindow, nullptr);
}

static void ClosePoseWindow() {
    FreePosePictures();
    ClipCursor(nullptr);
    PostQuitMessage(PickedPose);
    PoseWindow = nullptr;
}

LRESULT PoseWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_CREATE:
        LoadPosePictures(WindowInstance(window));
        return 0;
    case WM_DESTROY:
        ClosePoseWindow();
        return 0;
    case WM_SIZE:
        SizePoseWindow(window);
        ClipToPoseWindow(window);
        return 0;
    case WM_PAINT:
        PaintPoseWindow(window);
        return 0;
    case WM_CLOSE:
        DestroyWindow(window);
        return 0;
    case WM_KEYDOWN:
        PoseKey(window, wParam);
        return 1;
    case WM_LBUTTONDOWN:
        PickPoseAt(window, lParam);
        return 1;
    case WM_LBUTTONUP:
        DestroyWindow(window);
        return 1;
    default:
        return DefWindowProcA(window, message, wParam, lParam);
    }
}

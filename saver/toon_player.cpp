#include "saver/toon_player.h"

#include "platform/kernel.h"
#include "saver/show_cycle.h"
#include "stage/backdrop.h"
#include "stage/player.h"
#include "stage/stage.h"
#include "stage/window_loop.h"
#include "toon/toon_document.h"

HINSTANCE PlayerClassInstance;
HWND PlayerWindow;

constexpr const char* PLAYER_CLASS = "SaverWndClass";
constexpr int PLAYER_ICON = 100;

BOOL PlayerClassSetup(HINSTANCE instance) {
    PlayerClassInstance = instance;
    return RegisterGreyClass(PLAYER_CLASS, PlayerProc, instance, LoadIconA(instance, PLAYER_ICON));
}

int CreatePlayerWindow(HINSTANCE instance, HWND parent) {
    PlayerWindow =
        CreateWindowExA(0, PLAYER_CLASS, "", WS_POPUP, 0, 0, GetSystemMetrics(SM_CXSCREEN),
                        GetSystemMetrics(SM_CYSCREEN), parent, nullptr, instance, nullptr);
    if (!PlayerWindow) {
        return 0;
    }
    ShowWindow(PlayerWindow, SW_SHOWNORMAL);
    UpdateWindow(PlayerWindow);
    return 1;
}

int RunPlayer(HINSTANCE instance, HWND parent, const char* name) {
    if (IsWindow(PlayerWindow)) {
        return 0; // there is one stage: a double-click that comes late opens no second player
    }
    if (!PlayerClassInstance && !PlayerClassSetup(instance)) {
        return 0;
    }
    if (!CreatePlayerWindow(instance, parent)) {
        return 0;
    }
    CopyText(NextToonFile, name, NEXT_TOON_SIZE);
    return RunWindowLoop(PlayerWindow, nullptr);
}

LRESULT PlayerProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    const HINSTANCE instance = WindowInstance(window);
    switch (message) {
    case WM_CREATE:
        ShowSetup(window, instance);
        return 0;
    case WM_DESTROY:
        ShowTeardown(window);
        PostQuitMessage(0);
        return 0;
    case WM_SIZE:
        SetWindowPos(window, HWND_TOP, 0, 0, 0, 0, SWP_NOSIZE);
        return ShowResize(window, instance, static_cast<DWORD>(lParam));
    case WM_ACTIVATE:
        StageRepaintFlag = 1;
        return 0;
    case WM_PAINT:
        PaintStage(window, &StageRepaintFlag);
        return 0;
    case WM_CLOSE:
        DestroyWindow(window);
        return 0;
    case WM_KEYDOWN:
    case WM_SYSKEYDOWN:
    case WM_LBUTTONDOWN:
    case TM_SHOWDONE:
        SendMessageA(window, WM_CLOSE, 0, 0);
        return 1;
    case WM_TIMER:
        return ShowTimer(window, instance, wParam);
    case TM_WALKDONE:
        WalkDoneDispatch(window);
        return 0;
    default:
        return DefWindowProcA(window, message, wParam, lParam);
    }
}

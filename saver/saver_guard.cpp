#include "saver/saver_guard.h"

#include "saver/show_cycle.h"
#include "stage/stage.h"

static DWORD CloseWaits; // 1 while a request to close is queued

/// One request at a time: a key held down doesn't queue a second one behind the first.
static void RequestClose(HWND window) {
    if (CloseWaits == 0 && PostMessageA(window, WM_CLOSE, 0, 0)) {
        CloseWaits = 1;
    }
}

LRESULT SaverGuardProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_CREATE) {
        CloseWaits = 0;
    } else if (message == WM_DESTROY) {
        PostQuitMessage(0);
    }
    return ShowProc(window, message, wParam, lParam);
}

LRESULT SaverDefaultProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_CLOSE:
        CloseWaits = 0;
        break;
    case WM_KEYDOWN:
    case WM_SYSKEYDOWN:
    case WM_LBUTTONDOWN:
    case WM_RBUTTONDOWN:
    case WM_MBUTTONDOWN:
        if (PreviewMode == 0) {
            RequestClose(window);
        }
        break;
    default:
        break;
    }
    return DefWindowProcA(window, message, wParam, lParam);
}

void LoadPasswordModule() {}

void UnloadPasswordModule() {}

void RebootDeviceCall(DWORD /*code*/) {}

// Painting a window, and its own answers to messages.
#include "platform/gdi/surface.h"
#include "platform/harness.h"
#include "platform/user/controls/control.h"
#include "platform/user/dialog.h"
#include "platform/user/frame_window.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/roster.h"
#include "platform/user/text.h"
#include "platform/user/window.h"

using namespace seam;

static RECT clientOf(const Window& window) {
    return {0, 0, window.width(), window.height()};
}

HDC GetDC(HWND window) {
    Window* found = findWindow(window);
    return found == nullptr || found->picture() == nullptr
               ? HDC{}
               : makeSurfaceContext(*found->picture(), clientOf(*found));
}

int ReleaseDC(HWND /*window*/, HDC dc) {
    return DeleteDC(dc) != FALSE ? 1 : 0;
}

HDC BeginPaint(HWND window, PAINTSTRUCT* paint) {
    Window* found = findWindow(window);
    if (found == nullptr || found->picture() == nullptr) {
        *paint = {};
        return {};
    }
    const bool erase = found->eraseNeeded;
    paint->rcPaint = found->paintNeeded ? found->update : RECT{0, 0, 0, 0};
    found->paintNeeded = false;
    found->painted = true;
    found->eraseNeeded = false;
    paint->hdc = makeSurfaceContext(*found->picture(), paint->rcPaint);
    paint->fErase =
        erase && SendMessageA(window, WM_ERASEBKGND, paint->hdc.number, 0) == 0 ? TRUE : FALSE;
    return paint->hdc;
}

BOOL EndPaint(HWND /*window*/, const PAINTSTRUCT* paint) {
    DeleteDC(paint->hdc);
    return TRUE;
}

BOOL InvalidateRect(HWND window, const RECT* area, BOOL erase) {
    Window* found = findWindow(window);
    if (found == nullptr) {
        return FALSE;
    }
    invalidate(*found, area == nullptr ? clientOf(*found) : *area, erase != FALSE);
    return TRUE;
}

BOOL UpdateWindow(HWND window) {
    const Window* found = findWindow(window);
    if (found == nullptr) {
        return FALSE;
    }
    if (found->paintNeeded && found->visible) {
        SendMessageA(window, WM_PAINT, 0, 0);
        flushWindows();
    }
    return TRUE;
}

static LRESULT eraseBackground(const Window& window, HDC dc) {
    if (!window.windowClass->background) {
        return 0;
    }
    const RECT area = clientOf(window);
    FillRect(dc, &area, window.windowClass->background);
    return 1;
}

static LRESULT setTitle(Window& window, const char* title) {
    window.title = title == nullptr ? "" : title;
    toolkitWindow(window)->setTitle(shownText(window.title));
    if (window.dialog || window.frame) {
        widgetOf(window).setWindowTitle(shownText(window.title));
    }
    if (!window.parent && !window.dialog) {
        leaveRoster(window.handle);
        joinRoster(window);
    }
    return TRUE;
}

static void setOwnCursor(const Window& window, LRESULT hit) {
    if (hit != HTCLIENT) {
        SetCursor(LoadCursorA(nullptr, IDC_ARROW));
    } else if (window.windowClass->cursor) {
        SetCursor(window.windowClass->cursor);
    }
}

LRESULT DefWindowProcA(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    Window* found = findWindow(window);
    if (found == nullptr) {
        return 0;
    }
    switch (message) {
    case WM_CLOSE:
    case WM_ENDSESSION:
        DestroyWindow(window);
        return 0;
    case WM_SYSCOMMAND:
        return wParam == SC_CLOSE ? SendMessageA(window, WM_CLOSE, 0, 0) : 0;
    case WM_PAINT: {
        PAINTSTRUCT paint{};
        BeginPaint(window, &paint);
        EndPaint(window, &paint);
        return 0;
    }
    case WM_ERASEBKGND:
        return eraseBackground(*found, HDC{static_cast<DWORD>(wParam)});
    case WM_NCHITTEST:
        return HTCLIENT;
    case WM_NCLBUTTONDOWN:
        if (wParam == HTCAPTION && found->frame) {
            found->frame->drag();
        }
        return 0;
    case WM_SETCURSOR:
        setOwnCursor(*found, LOWORD(static_cast<DWORD>(lParam)));
        return 0;
    case WM_SETTEXT:
        return setTitle(*found, reinterpret_cast<const char*>(lParam));
    default:
        return 0;
    }
}

BOOL SetWindowTextA(HWND window, const char* text) {
    return SendMessageA(window, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(text)) != 0 ? TRUE : FALSE;
}

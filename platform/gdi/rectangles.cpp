// Rectangles, and the colours of the system: what needs no context.
#include "platform/gdi.h"

static LONG wrapAdd(LONG a, LONG b) {
    return static_cast<LONG>(static_cast<DWORD>(a) + static_cast<DWORD>(b));
}

static LONG wrapSubtract(LONG a, LONG b) {
    return static_cast<LONG>(static_cast<DWORD>(a) - static_cast<DWORD>(b));
}

BOOL InflateRect(RECT* rectangle, int dx, int dy) {
    if (rectangle == nullptr) {
        return FALSE;
    }
    rectangle->left = wrapSubtract(rectangle->left, dx);
    rectangle->top = wrapSubtract(rectangle->top, dy);
    rectangle->right = wrapAdd(rectangle->right, dx);
    rectangle->bottom = wrapAdd(rectangle->bottom, dy);
    return TRUE;
}

BOOL PtInRect(const RECT* rectangle, POINT point) {
    return rectangle != nullptr && point.x >= rectangle->left && point.x < rectangle->right &&
                   point.y >= rectangle->top && point.y < rectangle->bottom
               ? TRUE
               : FALSE;
}

DWORD GetSysColor(int index) {
    switch (index) {
    case COLOR_ACTIVECAPTION:
        return RGB(0, 0, 128);
    case COLOR_BTNFACE:
        return RGB(192, 192, 192);
    case COLOR_BTNSHADOW:
        return RGB(128, 128, 128);
    case COLOR_BTNHIGHLIGHT:
    case COLOR_WINDOW:
        return RGB(255, 255, 255);
    default:
        return RGB(0, 0, 0);
    }
}

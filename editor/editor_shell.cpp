#include "editor/editor_shell.h"

HWND EditorMainWindow;

int RunEditor(HINSTANCE /*instance*/, HWND owner, int /*showCommand*/) {
    MessageBoxA(owner, "There is no Toon editor yet.", "Fenky Dorbo Toon File Editor",
                MB_ICONEXCLAMATION);
    return 0;
}

void CentreDialog(HWND window) {
    RECT place{};
    GetWindowRect(window, &place);
    const int width = place.right - place.left;
    const int height = place.bottom - place.top;
    MoveWindow(window, (GetSystemMetrics(SM_CXSCREEN) - width) / 2,
               (GetSystemMetrics(SM_CYSCREEN) - height) / 2, width, height, FALSE);
}

#include "editor/frame_editor.h"

#include "stage/editor_host.h"

HWND EditorDialog;

void OpenFrameEditor(HWND mainWindow, HINSTANCE /*instance*/) {
    MessageBoxA(mainWindow, "There is no frame editor yet.", "Fenky Dorbo Toon File Editor",
                MB_ICONEXCLAMATION);
}

int FrameEditorAccelerator(HINSTANCE /*instance*/, int /*id*/) {
    return 0;
}

void SetEditedPosition(LONG /*x*/, LONG /*y*/) {}

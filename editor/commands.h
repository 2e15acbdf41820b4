// The commands of the editor's main window: from its buttons, its keys, and the menu of its File
// button. All come as WM_COMMAND. While the frame editor is open, the keys are its own.
#pragma once

#include "platform/user.h"

/// The handler of WM_COMMAND: a button's, else a key's, else a menu item's.
void EditorCommand(HWND mainWindow, HINSTANCE instance, WPARAM wParam, LPARAM lParam);

/// The menu lasts as long as the main window.
void CreateFilePopup();
void DestroyFilePopup();

/// Greys what can't be chosen now, and opens the menu above the File button.
void ShowFilePopup(HWND mainWindow);

// The commands of the editor's main window: from its buttons, its keys, and the menu of its File
// button. All come as WM_COMMAND. While the frame editor is open, the keys are its own.
#pragma once

#include "platform/user.h"

/// The handler of WM_COMMAND: ControlCommand, AcceleratorCommand, PopupCommand, until one takes it.
void EditorCommand(HWND mainWindow, HINSTANCE instance, WPARAM wParam, LPARAM lParam);

/// 1 if `control` is one of the five buttons, whose command has then run, else 0.
int ControlCommand(HWND mainWindow, LPARAM control, HINSTANCE instance);

/// 1 if the low word of wParam is the id of a key that means something now; its command runs if the
/// button that stands for it is enabled. Else 0.
int AcceleratorCommand(HWND mainWindow, WPARAM wParam, HINSTANCE instance);

/// Runs the command of a menu item; nothing for any other id.
void PopupCommand(HWND mainWindow, WPARAM wParam, HINSTANCE instance);

/// The menu lasts as long as the main window.
void CreateFilePopup();
void DestroyFilePopup();

/// Greys what can't be chosen now, and opens the menu above the File button.
void ShowFilePopup(HWND mainWindow);

// The Toon editor's main window.
#pragma once

#include "platform/dialogs.h"

/// The editor's main window; null while no editor is open.
extern HWND EditorMainWindow;

/// Opens the editor and runs it to its end. There is no editor yet: a box over the owner says so.
/// Gives 0.
int RunEditor(HINSTANCE instance, HWND owner, int showCommand);

/// Puts a window into the middle of the screen.
void CentreDialog(HWND window);

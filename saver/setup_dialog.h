// The setup dialog: how the saver shows itself, and where its Toons lie.
#pragma once

#include "platform/dialogs.h"

/// The procedure of the dialog. OK and Cancel both save the settings and end it with 1; Cancel
/// takes nothing from the controls, but keeps where the list has gone.
LRESULT SetupDialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);

/// Sets the buttons and the list from the settings.
void SetupFillControls(HWND dialog);

/// Enables the group that WalkingStyleChoice has chosen, and disables the other.
void SetupEnableControls(HWND dialog);

/// Goes to Directory and lists its Toons, its directories and the drives. Where it can't be
/// entered, count and list stay as they are.
void SetupRefreshList(HWND dialog);

/// Takes the buttons into the settings, in memory.
void SetupCommit(HWND dialog);

/// Acts on the selected entry of the list: a directory is gone into, a Toon played.
void SetupOpenEntry(HWND dialog, HINSTANCE instance);

/// What an entry of the list does to a directory.
enum class EntryStep { file, moved, refused };

/// Changes `directory`, which holds DIRECTORY_SIZE bytes, as a double-click on the entry asks. A
/// path that doesn't fit is refused and changes nothing, and so is the way up from a path without
/// an element to take off. Anything that names no directory is a file.
EntryStep StepDirectory(char* directory, const char* entry);

/// Closes the Toon editor if it is open.
void CloseEditorIfOpen();

/// Opens the editor for an empty name, plays a Toon whose name ends in ".zkt", and walks about for
/// any other name. Gives what that run gives.
int OpenToonTarget(HINSTANCE instance, HWND parent, const char* name, int showCommand);

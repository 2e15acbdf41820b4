// What asks the user about the open Toon: whether to save it, which file to open. `owner` is the
// window over which boxes and dialogs stand.
#pragma once

#include "platform/user.h"

// What the editor's main window is told.
constexpr UINT TM_BACKGROUND = 1028; // build the backdrop anew and repaint: tile or caption is new
constexpr UINT TM_ENABLEPLAY = 1029; // enable the Play button, or by a wParam of 0 disable it
constexpr UINT TM_EDITORCLOSED = 1030; // the frame editor has gone

/// The command of the frame editor's Save button, which puts its fields into the frame.
constexpr int COMMIT_FRAME_COMMAND = 1012;

/// Asks whether to save unsaved changes; nothing is asked where there are none. 1: go on, 0: stop.
/// Yes asks for a name if there is none, has the owner commit its fields by COMMIT_FRAME_COMMAND
/// and gives what ToonSave gave. No and Cancel leave the changes in memory.
int ToonPromptSave(HWND owner);

/// ToonPromptSave, then the file dialog: 1 if the user has chosen a file, whose name then stands in
/// ToonFileName.
int ToonChoose(HWND owner);

/// ToonChoose, then ToonLoad. Gives what that gave; 0 also where nothing was chosen.
LONG ToonOpen(HWND owner);

/// ToonPromptSave, and the Toon has no name any more. 0 if the user has stopped it.
int ToonNew(HWND owner);

/// The Open command of the editor's main window: forgets the name of the open Toon and opens
/// another. 1 once it is there: its first frame is the current one, and the main window has been
/// told to enable Play and to show tile and caption. Else 0, also for a load that failed, and the
/// name is empty.
int ToonOpenFromMenu(HWND mainWindow);

/// The same with the Toon of that path, which nobody is asked for.
int ToonOpenPath(HWND mainWindow, const char* path);

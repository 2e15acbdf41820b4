// The player of a single Toon: one show on the whole screen, out of the setup dialog.
//
// It shares the stage's start and end with the saver, but not its guard: only a key, the left
// button or the end of the show close it, and it never asks for a password.
#pragma once

#include "platform/user.h"

extern HINSTANCE PlayerClassInstance; // for which the class was set up; null until then
extern HWND PlayerWindow;             // null until one has been made

/// Shows the Toon of that bare name in the current directory, or walks about once for an empty
/// name, until it is over. 0, also if the window can't be made or there is one already.
int RunPlayer(HINSTANCE instance, HWND parent, const char* name);

BOOL PlayerClassSetup(HINSTANCE instance); ///< nonzero on success

/// Makes the window and shows it; 1 on success.
int CreatePlayerWindow(HINSTANCE instance, HWND parent);

LRESULT PlayerProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

// The guard of the saver window: what ends it, and what it asks for before it lets go.
//
// A message runs through SaverGuardProc, ShowProc and SaverDefaultProc, in this order. At present a
// key or a button ends the saver at once, and no password applies.
#pragma once

#include "platform/user.h"

constexpr DWORD REBOOT_PASSWORD_SET = 1;     // a password has taken effect
constexpr DWORD REBOOT_PASSWORD_DROPPED = 2; // it no longer has

/// The window procedure of the saver window's class.
LRESULT SaverGuardProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// The last procedure of the chain: input posts WM_CLOSE, everything else gets the platform's own
/// answer. In the preview input does nothing.
LRESULT SaverDefaultProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// Loads the module that asks for the password, if one applies: none does yet.
void LoadPasswordModule();
void UnloadPasswordModule();

/// Tells the system's reboot device that a password takes effect or is dropped: as none does, there
/// is nothing to tell yet.
void RebootDeviceCall(DWORD code);

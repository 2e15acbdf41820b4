// The guard of the saver window: what ends it, and what it asks for before it lets go.
//
// A message runs through three procedures, always in this order: SaverGuardProc answers it or
// passes it on to ShowProc (the show), which hands what it doesn't take to SaverDefaultProc
// (input, closing, the password). The window is in one of four states: normal; preview
// (PreviewMode is set), where hardly anything is guarded; verifying (SaverVerifying is set), while
// the password is asked for and input has no effect; closing (SaverClosing is set), once it may go.
#pragma once

#include "platform/user.h"

constexpr DWORD REBOOT_PASSWORD_SET = 1;     // a password has taken effect
constexpr DWORD REBOOT_PASSWORD_DROPPED = 2; // it no longer has

/// 1 while VerifyBeforeClose is at work. Written by it alone.
extern DWORD SaverVerifying;

/// Non-zero once the saver may end, for the rest of the process: what the verifier gave, or 1
/// where no password applies. Written by VerifyBeforeClose.
extern DWORD SaverClosing;

/// Where the mouse was when its travel began to count, in pixels of the screen. Written when the
/// window is made and when a password was refused.
extern POINT MouseStartPos;

using VerifyEntry = BOOL (*)(HWND window);

/// Asks the user for the password over a window; non-zero if the user may pass. Null while no
/// password applies. Written by LoadPasswordModule and UnloadPasswordModule.
extern VerifyEntry VerifyPassword;

/// The window procedure of the saver window's class.
LRESULT SaverGuardProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// The last procedure of the chain. TM_VERIFYPASSWORD is answered in every state. In the normal
/// state a key or a button that goes down, 4 pixels of the mouse's travel and the loss of
/// activation post WM_CLOSE; in the others no input does anything, and WM_CLOSE gets the platform's
/// own answer.
LRESULT SaverDefaultProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// Asks for the password if one applies; non-zero if the window may now be destroyed. Messages of
/// the window are handled meanwhile, and what the user did to it before the answer has no effect.
DWORD VerifyBeforeClose(HWND window);

/// Loads the module that asks for the password, if the registry says that one applies. Anything
/// that is missing on the way counts as no password.
void LoadPasswordModule();
void UnloadPasswordModule();

/// Tells the system's reboot device that a password takes effect or is dropped; does nothing where
/// there is no such device.
void RebootDeviceCall(DWORD code);

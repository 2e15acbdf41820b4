// Windows that have a message loop to themselves: their class, and the loop, which ends when its
// window has gone.
#pragma once

#include "platform/user.h"

/// Sets up a window class with the arrow on light grey ground, repainted at each new size; 0 if it
/// can't be, as where the name is taken.
WORD RegisterGreyClass(const char* name, WNDPROC procedure, HINSTANCE instance, HICON icon);

/// Sees to a message before it is dispatched; nonzero if it is done with.
using MessageTranslator = int (*)(const MSG* message);

/// Runs until the window has gone, and gives the exit code that its end posts, else 0. A quit that
/// finds it alive was meant for a loop that ended another way, and is passed over. `translate` may
/// be null.
int RunWindowLoop(HWND window, MessageTranslator translate);

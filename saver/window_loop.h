// The message loop of a window that fills the screen.
#pragma once

#include "platform/user.h"

/// Runs until the window has gone, and gives the exit code that its end posts, else 0. A quit that
/// finds it alive was meant for a loop that ended another way, and is passed over.
int RunWindowLoop(HWND window);

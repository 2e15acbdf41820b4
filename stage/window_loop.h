// The message loop of a window that has one to itself: it ends when its window has gone.
#pragma once

#include "platform/user.h"

/// Sees to a message before it is dispatched; nonzero if it is done with.
using MessageTranslator = int (*)(const MSG* message);

/// Runs until the window has gone, and gives the exit code that its end posts, else 0. A quit that
/// finds it alive was meant for a loop that ended another way, and is passed over. `translate` may
/// be null.
int RunWindowLoop(HWND window, MessageTranslator translate);

// Which top-level windows of this program's processes there are, across the processes of one user
// on one display. Each window with a title listens on a local socket whose name tells of both.
#pragma once

#include "platform/user/window.h"

namespace seam {

/// Makes the window findable from other processes; a byte sent to it brings it to the front.
void joinRoster(const Window& window);
void leaveRoster(HWND window);

/// A window of another process, as a handle that lasts as long as this process; null if none.
HWND findRemote(const std::string& className, const std::string& title);

bool isRemote(HWND window);

/// Asks the other process to bring its window to the front.
bool raiseRemote(HWND window);

} // namespace seam

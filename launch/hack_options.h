// What a program that hosts savers asks of dorbo-hack: in which window it is to show itself.
#pragma once

#include "platform/types.h"

#include <string>
#include <vector>

enum class HackTarget {
    WINDOW,  // the window of that id
    DESKTOP, // the root window
    NOWHERE, // no window was named
    HELP,    // none is wanted but the help
    WRONG,   // the command line can't be understood
};

struct HackRequest {
    HackTarget target = HackTarget::NOWHERE;
    DWORD window = 0;      // its id, with WINDOW
    std::string complaint; // for the user, with NOWHERE and WRONG; a clause without a full stop
};

/// Reads the arguments behind the program's name and the variable XSCREENSAVER_WINDOW (null: not
/// set). --window-id names a window; --root means the variable's, or without the variable the root
/// window. Of several the last one counts, and without any the variable. One minus sign will do
/// for two.
HackRequest ReadHackArguments(const std::vector<std::string>& arguments, const char* variable);

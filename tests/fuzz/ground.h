// A home and a directory of Toons for a user at random, and what has to hold when he has left.
#pragma once

#include "tests/fuzz/user.h"

#include <string_view>

namespace fuzz {

/// Set when what a process makes once has been made: from then on a run leaves nothing behind.
inline bool warm = false;

/// Sends a user to a place who does what the bytes say and then leaves. Once `warm`, no handle and
/// no window is left behind; each Toon on the disk loads.
void runWithUser(std::string_view bytes, const Place& place);

/// What always holds of the frame editor, if it is open.
void checkFrameEditor();

} // namespace fuzz

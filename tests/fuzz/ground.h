// What lies round a user at random, and what has to hold of it.
#pragma once

#include <filesystem>

namespace fuzz {

/// Puts Toons there, good ones, odd ones and one that doesn't load, and the settings of a user who
/// has had the program for a while.
void beginAnew(const std::filesystem::path& toons);

/// Each Toon there loads, but the one that never did.
void checkToons(const std::filesystem::path& toons);

/// What always holds of the frame editor, if it is open.
void checkFrameEditor();

} // namespace fuzz

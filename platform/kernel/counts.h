// Live objects of this folder, for the count of all handles.
#pragma once

#include <cstddef>

namespace seam {

std::size_t liveMemoryBlocks();
std::size_t liveFiles();
std::size_t liveSearches();
std::size_t liveDevices();
std::size_t liveKeys();
std::size_t loadedModules();

} // namespace seam

#include "platform/kernel/counts.h"

#include "platform/harness.h"

namespace seam {

void countKernelHandles(HandleCounts& counts) {
    counts.memoryBlocks = liveMemoryBlocks();
    counts.files = liveFiles();
    counts.searches = liveSearches();
    counts.devices = liveDevices();
    counts.keys = liveKeys();
    counts.modules = loadedModules();
}

} // namespace seam

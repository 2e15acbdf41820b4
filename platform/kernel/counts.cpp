#include "platform/kernel/counts.h"

#include "platform/harness.h"

namespace seam {

void countKernelHandles(HandleCounts& counts) {
    counts.memoryBlocks = liveMemoryBlocks();
    counts.files = liveFiles();
    counts.searches = liveSearches();
}

} // namespace seam

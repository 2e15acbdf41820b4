#include "platform/gdi/pixel_block.h"

#include "platform/kernel/faults.h"

#include <cstdlib>
#include <sys/mman.h>

namespace seam {

namespace {

/// From a megabyte on pixels are mapped, so that a freed picture of the stage goes back to the
/// system at once. In the heap it would leave a hole that small bitmaps nibble at, until the next
/// picture of that size no longer fits there. The bitmaps of a sprite, made and freed at each step,
/// are best off in the heap: their pages stay.
constexpr std::size_t mappedFrom = std::size_t{1} << 20U;

} // namespace

void PixelRelease::operator()(DWORD* pixels) const {
    const std::size_t bytes = count * sizeof(DWORD);
    if (bytes == 0) {
        return; // not ours
    }
    if (bytes < mappedFrom) {
        std::free(pixels);
    } else {
        munmap(pixels, bytes);
    }
}

PixelBlock makePixels(std::size_t count) {
    const std::size_t bytes = count * sizeof(DWORD);
    void* memory = nullptr;
    if (faultDue(Operation::picture)) {
        return {};
    }
    if (bytes < mappedFrom) {
        memory = std::malloc(bytes);
    } else {
        memory = mmap(nullptr, bytes, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        memory = memory == MAP_FAILED ? nullptr : memory;
    }
    return {static_cast<DWORD*>(memory), PixelRelease{count}};
}

} // namespace seam

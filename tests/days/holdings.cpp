#include "tests/days/holdings.h"

#include <filesystem>
#include <fstream>
#include <iterator>

#include <malloc.h>
#include <unistd.h>

#if defined(__SANITIZE_ADDRESS__)
#define DORBO_ADDRESS_SANITIZER
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define DORBO_ADDRESS_SANITIZER
#endif
#endif

#ifdef DORBO_ADDRESS_SANITIZER
#include <sanitizer/allocator_interface.h>

static std::size_t heapInUse() {
    return __sanitizer_get_current_allocated_bytes();
}
#else

static std::size_t heapInUse() {
    const struct mallinfo2 info = mallinfo2();
    return info.uordblks + info.hblkhd;
}
#endif

static std::size_t residentMemory() {
    std::ifstream statm("/proc/self/statm");
    std::size_t total = 0;
    std::size_t resident = 0;
    statm >> total >> resident;
    constexpr std::size_t kibibyte = 1024;
    return resident * static_cast<std::size_t>(sysconf(_SC_PAGESIZE)) / kibibyte;
}

static std::size_t openFiles() {
    const std::filesystem::directory_iterator descriptors("/proc/self/fd");
    return static_cast<std::size_t>(std::distance(begin(descriptors), end(descriptors)));
}

Holdings HoldingsNow() {
    return {heapInUse(), openFiles(), residentMemory(), seam::liveHandles()};
}

std::size_t HandlesOf(const Holdings& holdings) {
    const seam::HandleCounts& of = holdings.handles;
    return of.windows + of.deviceContexts + of.gdiObjects + of.palettes + of.memoryBlocks +
           of.files + of.searches + of.devices + of.keys + of.modules + of.timers + of.menus;
}

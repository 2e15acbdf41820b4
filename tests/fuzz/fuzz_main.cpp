// How libFuzzer calls a fuzzer.
#include "tests/fuzz/fuzz.h"

#include <cstdint>
#include <unistd.h>

/// No screen, whatever the user's desktop is, and files in memory if they may lie there.
extern "C" int LLVMFuzzerInitialize(int* /*count*/, char*** /*words*/) {
    constexpr const char* shared = "/dev/shm";
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    setenv("DORBO_SCALE", "1", 1);
    setenv("QT_LOGGING_RULES", "default.warning=false", 0); // of what that platform can't do
    if (access(shared, W_OK) == 0) {
        setenv("TMPDIR", shared, 1);
    }
    prepare();
    prepared = true;
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    tryInput({reinterpret_cast<const char*>(bytes), size});
    return 0;
}

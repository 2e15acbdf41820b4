// What all fuzzers have in common. How they are run: docs/fuzzing.md.
#pragma once

#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>
#include <unistd.h>

/// A promise of the program's that it has to keep for any input.
inline void demand(bool kept) {
    if (!kept) {
        std::abort();
    }
}

/// Where files lie in memory; the usual place for temporary ones where the user can't write there.
inline std::string directoryInMemory() {
    constexpr const char* shared = "/dev/shm";
    return access(shared, W_OK) == 0 ? shared : std::filesystem::temp_directory_path().string();
}

/// A directory for what a fuzzer writes, in memory if that can be, gone when it ends.
inline const std::filesystem::path& scratchDirectory() {
    struct Scratch {
        Scratch() {
            std::string name = directoryInMemory() + "/dorbo-fuzz-XXXXXX";
            const char* made = mkdtemp(name.data());
            demand(made != nullptr);
            path = made;
        }

        ~Scratch() {
            std::error_code ignored;
            std::filesystem::remove_all(path, ignored);
        }

        std::filesystem::path path;
    };

    static const Scratch scratch;
    return scratch.path;
}

/// No screen, whatever the user's desktop is, and files in memory. For the time before the first
/// window.
inline void standAlone() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    setenv("DORBO_SCALE", "1", 1);
    setenv("TMPDIR", directoryInMemory().c_str(), 1);
    setenv("QT_LOGGING_RULES", "default.warning=false", 0); // of what that platform can't do
}

inline std::string_view textOf(const std::uint8_t* bytes, std::size_t size) {
    return {reinterpret_cast<const char*>(bytes), size};
}

inline void writeBytes(const std::filesystem::path& path, std::string_view bytes) {
    std::ofstream file(path, std::ios::binary);
    file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

// What all fuzzers have in common. How they are run: docs/fuzzing.md.
#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string_view>

// Each fuzzer defines these two.

/// Makes what is made once in a process, before the first input.
void prepare();

/// Gives the program an input and demands what it has promised.
void tryInput(std::string_view bytes);

/// Set when that first one is done: from then on an input leaves nothing behind.
inline bool prepared = false;

/// A promise of the program's that it has to keep for any input.
inline void demand(bool kept) {
    if (!kept) {
        std::abort();
    }
}

inline void writeBytes(const std::filesystem::path& path, std::string_view bytes) {
    std::ofstream file(path, std::ios::binary);
    file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

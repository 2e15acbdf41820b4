// Films read back by other hands than those that write them: the libraries of GIF and PNG.
#pragma once

#include "platform/types.h"

#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

namespace test {

/// A whole picture of a film, 0x00rrggbb, and when it comes and goes in ms.
struct Shown {
    std::int64_t from;
    std::int64_t to;
    std::vector<DWORD> pixels;

    friend bool operator==(const Shown&, const Shown&) = default;
};

struct Film {
    int width = 0;
    int height = 0;
    bool forEver = false;        // whether it begins anew at its end
    std::int64_t drawn = 0;      // pixels that the file holds
    std::vector<Shown> pictures; // one that goes on standing is one
};

// Each throws a std::runtime_error if the file isn't as it has to be.
Film readGif(const std::filesystem::path& file);
Film readPng(const std::filesystem::path& file); // animated or plain
Film readDirectory(const std::filesystem::path& directory);

} // namespace test

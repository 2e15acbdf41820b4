// A directory in memory for what a fuzzer writes, gone when it ends.
#pragma once

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>

inline const std::filesystem::path& scratchDirectory() {
    struct Scratch {
        Scratch() {
            std::string name = "/dev/shm/dorbo-fuzz-XXXXXX";
            path = mkdtemp(name.data());
        }

        ~Scratch() {
            std::filesystem::remove_all(path);
        }

        std::filesystem::path path;
    };

    static const Scratch scratch;
    return scratch.path;
}

inline void writeBytes(const std::filesystem::path& path, const std::uint8_t* bytes,
                       std::size_t size) {
    std::ofstream file(path, std::ios::binary);
    file.write(reinterpret_cast<const char*>(bytes), static_cast<std::streamsize>(size));
}

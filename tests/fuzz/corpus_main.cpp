// Gives each file of the directories in CORPUS to a fuzzer, once and without libFuzzer. The name of
// the file that a fault was met at is the last one printed.
#include "tests/fuzz/fuzz.h"

#include <cstdint>
#include <cstdio>
#include <iterator>
#include <set>
#include <sstream>
#include <string>

extern "C" int LLVMFuzzerInitialize(int* count, char*** words);
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size);

int main(int count, char** words) {
    std::set<std::filesystem::path> files;
    std::istringstream directories(CORPUS); // parted by colons
    for (std::string directory; std::getline(directories, directory, ':');) {
        using Entries = std::filesystem::directory_iterator;
        files.insert(Entries(directory), Entries());
    }
    LLVMFuzzerInitialize(&count, &words);
    for (const auto& file : files) {
        std::fprintf(stderr, "%s\n", file.c_str());
        std::ifstream in(file, std::ios::binary);
        const std::string bytes(std::istreambuf_iterator<char>(in), {});
        LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size());
    }
    std::fprintf(stderr, "%zu files\n", files.size());
    return files.empty() ? 1 : 0;
}

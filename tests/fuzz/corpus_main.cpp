// Gives each file of the directories in CORPUS to a fuzzer's function, once and without a fuzzer.
// The name of the file that a fault was met at is the last one printed.
#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size);
extern "C" [[gnu::weak]] int LLVMFuzzerInitialize(int* count, char*** words);

namespace fs = std::filesystem;

static std::vector<fs::path> filesOf(const std::string& directories) { // parted by colons
    std::vector<fs::path> files;
    std::istringstream names(directories);
    for (std::string name; std::getline(names, name, ':');) {
        for (const auto& entry : fs::directory_iterator(name)) {
            files.push_back(entry.path());
        }
    }
    std::ranges::sort(files);
    return files;
}

int main(int count, char** words) {
    if (LLVMFuzzerInitialize != nullptr) {
        LLVMFuzzerInitialize(&count, &words);
    }
    const std::vector<fs::path> files = filesOf(CORPUS);
    for (const fs::path& file : files) {
        std::fprintf(stderr, "%s\n", file.c_str());
        std::ifstream in(file, std::ios::binary);
        const std::vector<char> bytes(std::istreambuf_iterator<char>(in), {});
        LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size());
    }
    std::fprintf(stderr, "%zu files\n", files.size());
    return files.empty() ? 1 : 0;
}

#include "cli/make_print.h"

#include "cli/toon_text.h"

#include <cstdio>
#include <fstream>
#include <optional>

namespace {

std::optional<std::string> ReadFile(const std::string& path) {
    std::FILE* file = std::fopen(path.c_str(), "rb");
    std::string bytes;
    char part[4096];
    std::size_t length = 0;
    while (file != nullptr && (length = std::fread(part, 1, sizeof part, file)) > 0) {
        bytes.append(part, length);
    }
    const bool complete = file != nullptr && std::ferror(file) == 0;
    if (file != nullptr) {
        std::fclose(file);
    }
    if (!complete) {
        std::fprintf(stderr, "toon: can't read %s\n", path.c_str());
        return std::nullopt;
    }
    return bytes;
}

bool WriteFile(const std::string& path, const std::string& bytes) {
    std::ofstream file(path, std::ios::binary);
    file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    file.close();
    if (!file) {
        std::fprintf(stderr, "toon: can't write %s\n", path.c_str());
    }
    return !file.fail();
}

} // namespace

int MakeCommand(const std::vector<std::string>& arguments) {
    const std::optional<std::string> text = ReadFile(arguments[0]);
    if (!text) {
        return 1;
    }
    const ToonFromText toon = TextToToon(*text);
    for (const std::string& warning : toon.warnings) {
        std::fprintf(stderr, "%s: %s\n", arguments[0].c_str(), warning.c_str());
    }
    if (!toon.error.empty()) {
        std::fprintf(stderr, "%s: %s\n", arguments[0].c_str(), toon.error.c_str());
        return 1;
    }
    return WriteFile(arguments[1], toon.bytes) ? 0 : 1;
}

int PrintCommand(const std::vector<std::string>& arguments) {
    const std::optional<std::string> bytes = ReadFile(arguments[0]);
    if (!bytes) {
        return 1;
    }
    const std::optional<std::string> text = ToonToText(*bytes);
    if (!text) {
        std::fprintf(stderr, "toon: %s is no Toon file\n", arguments[0].c_str());
        return 1;
    }
    return std::fputs(text->c_str(), stdout) < 0 || std::fflush(stdout) != 0 ? 1 : 0;
}

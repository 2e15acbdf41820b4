#include "cli/show_write.h"

#include "cli/help.h"
#include "cli/toon_json.h"

#include "platform/kernel/transfer.h"

#include <sys/stat.h>

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <filesystem>

namespace {

namespace fs = std::filesystem;

int Fail(const char* command, const std::string& file, const std::string& what) {
    std::fprintf(stderr, "toon %s: %s: %s\n", command, file.c_str(), what.c_str());
    return 1;
}

/// As the system says it, but that a file of another kind is called by that.
std::string Reason(int error) {
    return error == EINVAL ? "it is no regular file" : std::strerror(error);
}

constexpr mode_t readAndWrite = 0666;

/// The mode of a new file, as the user wants it.
mode_t NewFileMode() {
    const mode_t mask = umask(0);
    umask(mask);
    return readAndWrite & ~mask;
}

struct WriteOptions {
    std::string source;
    std::string target;
};

/// False if the arguments can't be understood.
bool ReadWriteOptions(const std::vector<std::string>& arguments, WriteOptions& options) {
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        if (arguments[i] == "-o" && i + 1 < arguments.size() && options.target.empty()) {
            options.target = arguments[++i];
        } else if (!arguments[i].starts_with('-') && options.source.empty()) {
            options.source = arguments[i];
        } else {
            return false;
        }
    }
    if (options.target.empty()) {
        options.target = fs::path(options.source).replace_extension(".zkt");
    }
    return !options.source.empty();
}

/// Why the file can't be read, or nothing.
std::string ReadWholeFile(const std::string& path, std::string& bytes) {
    seam::WholeFile file = seam::readWholeFile(path, INT32_MAX);
    bytes = std::move(file.text);
    return file.error == 0 ? "" : "it can't be read: " + Reason(file.error);
}

} // namespace

std::string ReadToon(const std::string& path, Toon& toon, std::size_t& size) {
    std::string bytes;
    const std::string unread = ReadWholeFile(path, bytes);
    size = bytes.size();
    return unread.empty() ? ToonFromBytes(bytes, toon) : unread;
}

int ShowCommand(const std::vector<std::string>& arguments) {
    const std::string& path = arguments.front();
    Toon toon{};
    std::size_t size = 0;
    const std::string error = ReadToon(path, toon, size);
    if (!error.empty()) {
        return Fail("show", path, error);
    }
    if (std::fputs(ToonToJson(toon).c_str(), stdout) < 0 || std::fflush(stdout) != 0) {
        return Fail("show", path, "it can't be printed: " + Reason(errno));
    }
    return 0;
}

int WriteCommand(const std::vector<std::string>& arguments) {
    WriteOptions options;
    if (!ReadWriteOptions(arguments, options)) {
        return TellWrongUsage("write", "");
    }
    std::string text;
    const std::string unread = ReadWholeFile(options.source, text);
    if (!unread.empty()) {
        return Fail("write", options.source, unread);
    }
    std::error_code missing;
    if (fs::equivalent(options.source, options.target, missing)) {
        return Fail("write", options.source,
                    "it would be written over itself; name a file with -o");
    }
    const ToonFromJson made = JsonToToon(text);
    if (!made.error.empty()) {
        std::fprintf(stderr, "toon write: %s:%s\n", options.source.c_str(), made.error.c_str());
        return 1;
    }
    for (const std::string& warning : made.warnings) {
        const std::size_t line = warning.find(' ');
        std::fprintf(stderr, "toon write: %s:%s warning:%s\n", options.source.c_str(),
                     warning.substr(0, line).c_str(), warning.substr(line).c_str());
    }
    if (!seam::replaceFile(options.target, ToonBytes(made.toon), NewFileMode())) {
        return Fail("write", options.target, "it can't be written: " + Reason(errno));
    }
    return 0;
}

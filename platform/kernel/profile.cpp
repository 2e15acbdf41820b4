// The profile service.

#include "platform/kernel.h"
#include "platform/kernel/config_directory.h"
#include "platform/kernel/paths.h"
#include "platform/kernel/profile_text.h"
#include "platform/kernel/text.h"
#include "platform/kernel/transfer.h"

#include <cerrno>
#include <ctime>
#include <fcntl.h>
#include <optional>
#include <set>
#include <string>
#include <sys/file.h>

namespace {

/// A larger file is somebody's mistake, and reading it would hold up the start: it counts as one
/// with no keys, and nothing is written to it.
constexpr std::size_t largestProfile = 16 << 20;

const char* orEmpty(const char* text) {
    return text != nullptr ? text : "";
}

bool hasDirectory(std::string_view name) {
    return name.find_first_of("\\/:") != std::string_view::npos;
}

/// The file's path in the file system; empty if there can be none, or if it can't be told which of
/// the directory's files it is.
std::string profilePath(const char* file) {
    const std::string_view name = orEmpty(file);
    if (name.empty() || hasDirectory(name)) {
        return seam::lookUpPath(name).path;
    }
    const std::string directory = seam::configDirectory();
    const std::optional<std::string> spelled = seam::spelledName(directory, name);
    if (!spelled) {
        return {};
    }
    return directory + "/" + (spelled->empty() ? std::string(name) : *spelled);
}

seam::WholeFile readProfile(const std::string& path) {
    return path.empty() ? seam::WholeFile{EINVAL, {}} : seam::readWholeFile(path, largestProfile);
}

/// The values that were asked for last when their file couldn't be read. Whoever asked has gone on
/// with something else, which must not be written over what stands there. Never destroyed: settings
/// are saved on the way out too.
std::set<std::string>& unknownValues() {
    static auto& values = *new std::set<std::string>;
    return values;
}

std::string valueName(const char* file, const char* section, const char* key) {
    return std::string(orEmpty(file)) + '\n' + section + '\n' + key;
}

std::optional<std::string> valueIn(const char* file, const char* section, const char* key) {
    const seam::WholeFile profile = readProfile(profilePath(file));
    const std::string name = valueName(file, orEmpty(section), orEmpty(key));
    if (profile.error != 0 && profile.error != ENOENT) {
        unknownValues().insert(name);
    } else {
        unknownValues().erase(name);
    }
    return seam::profileValue(profile.text, orEmpty(section), orEmpty(key));
}

/// Makes this process the only one to change profiles in a directory: two that write at once what
/// each has read lose keys. It goes on without after a while, for who has it may have been stopped.
seam::Descriptor lockBeside(const std::string& path) {
    constexpr int tries = 60;
    constexpr timespec pause{0, 5'000'000}; // 5 ms
    const std::string directory = path.substr(0, path.rfind('/') + 1);
    seam::Descriptor lock = seam::openDescriptor(directory, O_RDONLY | O_DIRECTORY);
    for (int i = 0; lock && i < tries && flock(lock.number(), LOCK_EX | LOCK_NB) != 0; ++i) {
        nanosleep(&pause, nullptr);
    }
    return lock;
}

} // namespace

UINT GetPrivateProfileIntA(const char* section, const char* key, int otherwise, const char* file) {
    const std::optional<std::string> value = valueIn(file, section, key);
    if (!value) {
        return static_cast<UINT>(otherwise);
    }
    UINT number = 0;
    for (const char letter : *value) {
        if (letter < '0' || letter > '9') {
            break;
        }
        number = number * 10 + static_cast<UINT>(letter - '0');
    }
    return number;
}

DWORD GetPrivateProfileStringA(const char* section, const char* key, const char* otherwise,
                               char* buffer, DWORD size, const char* file) {
    const std::optional<std::string> value = valueIn(file, section, key);
    return static_cast<DWORD>(seam::copyCut(value ? *value : orEmpty(otherwise), buffer, size));
}

BOOL WritePrivateProfileStringA(const char* section, const char* key, const char* value,
                                const char* file) {
    if (section == nullptr || key == nullptr || value == nullptr ||
        !seam::canStandInProfile(section, key, value)) {
        return FALSE;
    }
    if (!hasDirectory(orEmpty(file)) && !seam::makeConfigDirectory()) {
        return FALSE;
    }
    if (unknownValues().contains(valueName(file, section, key))) {
        return FALSE;
    }
    const seam::Descriptor lock = lockBeside(profilePath(file));
    const std::string path = profilePath(file); // of the file that is there under the lock
    const seam::WholeFile old = readProfile(path);
    if (old.error != 0 && old.error != ENOENT) {
        return FALSE;
    }
    if (seam::profileValue(old.text, section, key) == value) {
        return TRUE;
    }
    const std::string text = seam::profileWithValue(old.text, section, key, value);
    return seam::replaceFile(path, text) ? TRUE : FALSE;
}

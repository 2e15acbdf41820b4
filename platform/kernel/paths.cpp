#include "platform/kernel/paths.h"

#include "platform/kernel/faults.h"
#include "platform/kernel/text.h"

#include <dirent.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <memory>

namespace seam {

namespace {

constexpr std::string_view separators = "\\/";

/// Whether the path is the folder or lies in it.
bool liesIn(std::string_view path, std::string_view folder) {
    return path.starts_with(folder) && (path.size() == folder.size() || path[folder.size()] == '/');
}

/// The medium that holds the path, else C:. No medium lies in another.
const Drive& driveOf(std::string_view path, const std::vector<Drive>& known) {
    const auto medium = std::find_if(known.begin() + 1, known.end(), [path](const Drive& drive) {
        return liesIn(path, drive.root);
    });
    return medium != known.end() ? *medium : known.front();
}

std::vector<std::string> namesOf(std::string_view path, std::string_view marks) {
    std::vector<std::string> names;
    while (!path.empty()) {
        const std::size_t end = std::min(path.find_first_of(marks), path.size());
        if (end > 0) {
            names.emplace_back(path.substr(0, end));
        }
        path.remove_prefix(std::min(end + 1, path.size()));
    }
    return names;
}

/// Follows "." and ".." by the names alone. The root's ".." is the root.
std::vector<std::string> withoutDots(std::vector<std::string> names) {
    std::vector<std::string> result;
    for (std::string& name : names) {
        if (name == "..") {
            if (!result.empty()) {
                result.pop_back();
            }
        } else if (name != ".") {
            result.push_back(std::move(name));
        }
    }
    return result;
}

/// Whether something of this name is there; errno tells why not.
bool isThere(const std::string& path) {
    struct stat status = {};
    return lstat(path.empty() ? "/" : path.c_str(), &status) == 0;
}

PathLookup walk(std::string path, const std::vector<std::string>& names) {
    for (std::size_t at = 0; at < names.size(); ++at) {
        const std::string exact = path + "/" + names[at];
        if (isThere(exact)) {
            path = exact;
            continue;
        }
        if (errno != ENOENT) {
            return {.error = errno};
        }
        const auto spelled = spelledName(path.empty() ? "/" : path, names[at]);
        if (!spelled && errno != EACCES) {
            return {.error = errno};
        }
        if (spelled && !spelled->empty()) {
            path += "/" + *spelled;
        } else if (at + 1 == names.size()) {
            return {.path = exact};
        } else {
            return {.error = ENOENT};
        }
    }
    return {.exists = true, .path = path.empty() ? "/" : path};
}

/// A path taken apart: where it starts and which names follow.
struct Parted {
    const Drive* drive = nullptr;
    std::vector<std::string> names;
};

bool namesADrive(std::string_view path) {
    return path.size() >= 2 && path[1] == ':' && lowered(path)[0] >= 'a' && lowered(path)[0] <= 'z';
}

Parted partPath(std::string_view path, const std::vector<Drive>& known,
                const std::optional<std::string>& directory) {
    const Drive* here = directory ? &driveOf(*directory, known) : nullptr;
    const Drive* drive = here;
    if (namesADrive(path)) {
        const auto found = std::find_if(known.begin(), known.end(), [path](const Drive& one) {
            return sameButForCase({&one.letter, 1}, path.substr(0, 1));
        });
        drive = found != known.end() ? &*found : nullptr;
        path.remove_prefix(2);
    }
    if (drive == nullptr) {
        return {};
    }
    std::vector<std::string> names;
    const bool rooted = !path.empty() && separators.find(path.front()) != std::string_view::npos;
    if (!rooted && drive == here) {
        names = namesOf(std::string_view(*directory).substr(drive->root.size()), "/");
    }
    for (std::string& name : namesOf(path, separators)) {
        names.push_back(std::move(name));
    }
    return {drive, withoutDots(std::move(names))};
}

/// A file system has names like "c:x"; spelled just so and without a directory, such a name means
/// its file before it means a drive.
bool isNameWithColon(std::string_view path, const std::optional<std::string>& directory) {
    return namesADrive(path) && path.size() > 2 && directory &&
           path.find_first_of(separators) == std::string_view::npos &&
           isThere(*directory + "/" + std::string(path));
}

bool namesANetworkPath(std::string_view path) {
    return path.size() >= 2 && path.find_first_not_of(separators) >= 2;
}

} // namespace

std::string platformPath(std::string_view path, const std::vector<Drive>& known) {
    if (path.empty() || path.front() != '/') {
        return {};
    }
    const Drive& drive = driveOf(path, known);
    std::string result{drive.letter, ':'};
    const std::vector<std::string> names = namesOf(path.substr(drive.root.size()), "/");
    for (const std::string& name : names) {
        if (name.find('\\') != std::string::npos) {
            return {};
        }
        result += "\\" + name;
    }
    return names.empty() ? result + "\\" : result;
}

PathLookup lookUpPath(std::string_view path, const std::vector<Drive>& known,
                      const std::optional<std::string>& directory) {
    if (path.empty() || namesANetworkPath(path)) {
        return {.error = ENOENT};
    }
    if (isNameWithColon(path, directory)) {
        return {.exists = true, .path = *directory + "/" + std::string(path)};
    }
    const Parted parted = partPath(path, known, directory);
    if (parted.drive == nullptr) {
        return {.error = ENOENT};
    }
    PathLookup result = walk(parted.drive->root, parted.names);
    result.asFolder = separators.find(path.back()) != std::string_view::npos;
    return result;
}

PathLookup lookUpPath(std::string_view path) {
    return lookUpPath(path, drives(), currentDirectory());
}

std::optional<std::vector<std::string>> namesIn(const std::string& directory) {
    const auto close = [](DIR* listing) { closedir(listing); };
    const std::unique_ptr<DIR, decltype(close)> listing(
        faultDue(Operation::open) ? nullptr : opendir(directory.c_str()), close);
    std::vector<std::string> names;
    if (!listing) {
        return errno == ENOENT || errno == ENOTDIR ? std::optional(names) : std::nullopt;
    }
    errno = 0; // which tells the end of the names from a failure
    for (const dirent* entry = readdir(listing.get()); entry != nullptr;
         errno = 0, entry = readdir(listing.get())) {
        const std::string_view name = entry->d_name;
        if (name != "." && name != "..") {
            names.emplace_back(name);
        }
    }
    return errno == 0 ? std::optional(names) : std::nullopt;
}

std::optional<std::string> spelledName(const std::string& directory, std::string_view name) {
    if (isThere(directory + "/" + std::string(name))) {
        return std::string(name);
    }
    const std::optional<std::vector<std::string>> names = namesIn(directory);
    if (!names) {
        return std::nullopt;
    }
    std::string found;
    for (const std::string& candidate : *names) {
        if (sameButForCase(candidate, name) && (found.empty() || candidate < found)) {
            found = candidate;
        }
    }
    return found;
}

std::optional<std::string> currentDirectory() {
    const std::unique_ptr<char, decltype(&std::free)> path(getcwd(nullptr, 0), &std::free);
    if (!path || *path != '/') {
        return std::nullopt;
    }
    return path.get();
}

} // namespace seam

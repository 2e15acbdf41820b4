// Scans of directories and the current directory.

#include "platform/handle_table.h"
#include "platform/kernel.h"
#include "platform/kernel/counts.h"
#include "platform/kernel/paths.h"
#include "platform/kernel/pattern.h"
#include "platform/kernel/text.h"

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <string>

namespace {

/// The names of a scan as they stood at its start, and how far it has come.
struct Search {
    std::string directory;
    std::vector<std::string> names;
    std::size_t next = 0;
};

seam::HandleTable<Search> searches(seam::HandleKind::search);

DWORD attributesOf(const std::string& name, mode_t mode) {
    constexpr mode_t anybodyWrites = S_IWUSR | S_IWGRP | S_IWOTH;
    DWORD attributes = name.front() == '.' ? FILE_ATTRIBUTE_HIDDEN : 0;
    if (S_ISDIR(mode)) {
        return attributes | FILE_ATTRIBUTE_DIRECTORY;
    }
    attributes |= (mode & anybodyWrites) == 0 ? FILE_ATTRIBUTE_READONLY : 0;
    return attributes | FILE_ATTRIBUTE_ARCHIVE;
}

/// Tells of the thing that a link leads to, or of the link itself if that leads nowhere.
bool describe(const Search& search, const std::string& name, WIN32_FIND_DATAA& found) {
    const std::string path = search.directory + "/" + name;
    struct stat status = {};
    if (stat(path.c_str(), &status) != 0 && lstat(path.c_str(), &status) != 0) {
        return false;
    }
    found = {};
    found.dwFileAttributes = attributesOf(name, status.st_mode);
    found.nFileSizeLow = S_ISREG(status.st_mode) ? static_cast<DWORD>(status.st_size) : 0;
    seam::copyCut(name, found.cFileName, sizeof found.cFileName);
    return true;
}

/// Goes on to the next name that is still there.
bool advance(Search& search, WIN32_FIND_DATAA& found) {
    while (search.next < search.names.size()) {
        if (describe(search, search.names[search.next++], found)) {
            return true;
        }
    }
    return false;
}

bool canBeExpressed(std::string_view name) {
    return name.size() < MAX_PATH && name.find('\\') == std::string_view::npos;
}

std::vector<std::string> matchingNames(const std::string& directory, std::string_view pattern) {
    std::vector<std::string> names = seam::namesIn(directory).value_or(std::vector<std::string>());
    std::erase_if(names, [pattern](const std::string& name) {
        return !canBeExpressed(name) || !seam::matchesPattern(name, pattern);
    });
    std::sort(names.begin(), names.end());
    return names;
}

Search searchFor(const std::string& path) {
    const std::size_t mark = path.find_last_of("\\/:");
    const std::size_t start = mark == std::string::npos ? 0 : mark + 1;
    const std::string last = path.substr(start);
    const bool pattern = seam::isPattern(last);
    const std::string folder = start == 0 ? "." : path.substr(0, start);
    const seam::PathLookup place = seam::lookUpPath(pattern ? folder : path);
    if (!place.exists || (place.asFolder && !pattern)) {
        return {};
    }
    if (pattern) {
        return {place.path, matchingNames(place.path, last)};
    }
    const std::size_t slash = place.path.rfind('/');
    const std::string name = place.path.substr(slash + 1);
    return {place.path.substr(0, slash),
            name.empty() ? std::vector<std::string>{} : std::vector<std::string>{name}};
}

} // namespace

HANDLE FindFirstFileA(const char* pattern, WIN32_FIND_DATAA* found) {
    auto search = std::make_unique<Search>(searchFor(pattern != nullptr ? pattern : ""));
    if (found == nullptr || !advance(*search, *found)) {
        return INVALID_HANDLE_VALUE;
    }
    const DWORD handle = searches.add(std::move(search));
    return handle != 0 ? HANDLE{handle} : INVALID_HANDLE_VALUE;
}

BOOL FindNextFileA(HANDLE search, WIN32_FIND_DATAA* found) {
    Search* running = searches.find(search.number);
    return running != nullptr && found != nullptr && advance(*running, *found) ? TRUE : FALSE;
}

BOOL FindClose(HANDLE search) {
    return searches.take(search.number) ? TRUE : FALSE;
}

DWORD GetCurrentDirectoryA(DWORD size, char* buffer) {
    const std::optional<std::string> directory = seam::currentDirectory();
    const std::string path = seam::platformPath(directory.value_or(""), seam::drives());
    const auto length = static_cast<DWORD>(path.size());
    if (path.empty()) {
        return 0;
    }
    if (size <= length || buffer == nullptr) {
        return length + 1;
    }
    seam::copyCut(path, buffer, size);
    return length;
}

BOOL SetCurrentDirectoryA(const char* path) {
    const seam::PathLookup place = seam::lookUpPath(path != nullptr ? path : "");
    return place.exists && chdir(place.path.c_str()) == 0 ? TRUE : FALSE;
}

std::size_t seam::liveSearches() {
    return searches.live();
}

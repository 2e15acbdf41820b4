// Paths of the platform and paths of the file system, and the way between them.
//
// A path of the file system is any run of bytes, with slashes; here it is always absolute.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace seam {

struct Drive {
    char letter;
    std::string root; // where it lies in the file system, without a slash at the end: "" for C:
};

/// The drives: C:, then one from D: to Z: for each medium that stands in mountInfo (the text of
/// /proc/self/mountinfo) right under /media/USER or /run/media/USER, in the order of their bytes.
std::vector<Drive> drivesFrom(std::string_view mountInfo, std::string_view user);

/// The drives there are at this moment.
std::vector<Drive> drives();

/// The path in the platform's form, a path on a medium with its letter; empty if it can't be
/// expressed because a name in it holds a backslash.
std::string platformPath(std::string_view path, const std::vector<Drive>& known);

/// What a path of the platform means in the file system.
struct PathLookup {
    int error = 0;         // 0, or the errno of what keeps it from meaning anything
    bool exists = false;   // else only the last name is missing, and path tells where it would be
    bool asFolder = false; // a backslash stood at the end
    std::string path{};
};

/// Looks a path up. `directory` is what a path without a root starts from; without one such a path
/// means nothing. ".." takes the name before it off, also one that is a link. A link that leads
/// nowhere exists. In a directory that the user may enter but not list, names mean what they are
/// spelled like and nothing else; one that can't be listed for another reason is an error.
PathLookup lookUpPath(std::string_view path, const std::vector<Drive>& known,
                      const std::optional<std::string>& directory);

/// The same with the drives and the current directory there are at this moment.
PathLookup lookUpPath(std::string_view path);

/// The names in a directory, in no order, without "." and "..". Nothing if there is one that can't
/// be read; errno tells why.
std::optional<std::vector<std::string>> namesIn(const std::string& directory);

/// The name in a directory that a name means: itself if it is there, else the first one, in the
/// order of bytes, that is the same but for case. Empty if there is none. Nothing if the directory
/// can't be read, so that nobody knows; errno tells why.
std::optional<std::string> spelledName(const std::string& directory, std::string_view name);

/// The current directory; none if it has been removed.
std::optional<std::string> currentDirectory();

/// The user's home directory.
std::string homeDirectory();

} // namespace seam

// The user's media and the letters they have.

#include "platform/kernel/paths.h"
#include "platform/kernel/transfer.h"

#include <pwd.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <set>

namespace seam {

namespace {

constexpr std::size_t largestMountInfo = 16 << 20;

/// A mount point as the system writes it: blank, tab, line feed and backslash stand as a backslash
/// and three octal digits.
std::string unescaped(std::string_view text) {
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at) {
        const std::string_view digits = text.substr(at).substr(1, 3);
        const bool escape = text[at] == '\\' && digits.size() == 3 &&
                            digits.find_first_not_of("01234567") == std::string_view::npos;
        if (escape) {
            const int value = (digits[0] - '0') * 64 + (digits[1] - '0') * 8 + (digits[2] - '0');
            result += static_cast<char>(value);
            at += digits.size();
        } else {
            result += text[at];
        }
    }
    return result;
}

/// The blank-separated field of a line, counted from 0.
std::string_view field(std::string_view line, int number) {
    for (; number > 0; --number) {
        const std::size_t blank = line.find(' ');
        if (blank == std::string_view::npos) {
            return {};
        }
        line.remove_prefix(blank + 1);
    }
    return line.substr(0, line.find(' '));
}

bool isMediumOf(std::string_view user, std::string_view mountPoint) {
    for (const std::string_view top : {"/media/", "/run/media/"}) {
        const std::string folder = std::string(top) + std::string(user) + "/";
        if (mountPoint.starts_with(folder) && mountPoint.size() > folder.size() &&
            mountPoint.find('/', folder.size()) == std::string_view::npos) {
            return true;
        }
    }
    return false;
}

std::string userName() {
    const char* name = std::getenv("USER");
    if (name != nullptr && *name != '\0') {
        return name;
    }
    const passwd* entry = getpwuid(geteuid());
    return entry != nullptr ? entry->pw_name : "";
}

} // namespace

std::vector<Drive> drivesFrom(std::string_view mountInfo, std::string_view user) {
    constexpr int mountPointField = 4;
    std::set<std::string> media;
    while (!user.empty() && !mountInfo.empty()) {
        const std::string_view line = mountInfo.substr(0, mountInfo.find('\n'));
        const std::string mountPoint = unescaped(field(line, mountPointField));
        if (isMediumOf(user, mountPoint)) {
            media.insert(mountPoint);
        }
        mountInfo.remove_prefix(std::min(line.size() + 1, mountInfo.size()));
    }
    std::vector<Drive> result{{'C', ""}};
    for (const std::string& root : media) {
        if (result.back().letter == 'Z') {
            break;
        }
        result.push_back({static_cast<char>(result.back().letter + 1), root});
    }
    return result;
}

std::vector<Drive> drives() {
    return drivesFrom(readWholeFile("/proc/self/mountinfo", largestMountInfo).text, userName());
}

std::string homeDirectory() {
    const char* home = std::getenv("HOME");
    if (home != nullptr && *home == '/') {
        return home;
    }
    const passwd* entry = getpwuid(geteuid());
    return entry != nullptr ? entry->pw_dir : "";
}

} // namespace seam

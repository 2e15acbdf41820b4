#include "launch/toon_home.h"

#include "platform/kernel/paths.h"
#include "platform/kernel/transfer.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace fs = std::filesystem;

constexpr std::size_t LARGEST_TOON = 1 << 20; // bytes

static bool Complain(const fs::path& path, const std::string& why) {
    std::fprintf(stderr, "dorbo: %s: %s\n", path.c_str(), why.c_str());
    return false;
}

static fs::path DataHome() {
    const char* chosen = std::getenv("XDG_DATA_HOME");
    const bool absolute = chosen != nullptr && *chosen == '/';
    return absolute ? fs::path(chosen) : fs::path(seam::homeDirectory()) / ".local/share";
}

std::string FindInstalledToons(const std::string& program) {
    std::error_code ignored;
    const fs::path here = fs::path(program).parent_path();
    for (fs::path above = here.parent_path(); above != above.root_path();
         above = above.parent_path()) {
        const fs::path toons = above / "share/dorbo/toons";
        if (fs::is_directory(toons, ignored)) {
            return toons;
        }
    }
    for (const fs::path& base : {here, here.parent_path()}) {
        // Somebody's directory of that name may stand beside somebody's bin.
        if (fs::exists(base / "CMakeCache.txt", ignored) && fs::exists(base / "toons", ignored)) {
            return base / "toons";
        }
    }
    return "";
}

/// Copies the Toons of a directory into another one. A Toon plays only if it can be written, so the
/// copies can, whatever the installed ones allow. Empty, or what went wrong.
static std::string CopyToons(const fs::path& from, const fs::path& to) {
    std::error_code error;
    for (fs::directory_iterator entry(from, error), end; !error && entry != end;
         entry.increment(error)) {
        if (entry->path().extension() != ".zkt") {
            continue;
        }
        const seam::WholeFile toon = seam::readWholeFile(entry->path(), LARGEST_TOON);
        if (toon.error != 0) {
            return std::strerror(toon.error);
        }
        constexpr mode_t mode = 0644;
        if (!seam::replaceFile(to / entry->path().filename(), toon.text, mode)) {
            return std::strerror(errno);
        }
    }
    return error ? error.message() : "";
}

/// Gives a directory its name, unless there is something of that name. Whether it has it.
static bool PutInPlace(const fs::path& made, const fs::path& home) {
    if (renameat2(AT_FDCWD, made.c_str(), AT_FDCWD, home.c_str(), RENAME_NOREPLACE) == 0) {
        return true;
    }
    // Not every file system can do that. A plain rename replaces an empty directory at most.
    return errno == EINVAL && rename(made.c_str(), home.c_str()) == 0;
}

static bool MakeToonHome(const fs::path& installed, const fs::path& home) {
    std::error_code error;
    fs::create_directories(home.parent_path(), error);
    std::string made = home.string() + ".XXXXXX";
    if (mkdtemp(made.data()) == nullptr) {
        return Complain(home, std::strerror(errno));
    }
    constexpr mode_t mode = 0755;
    std::string fault = CopyToons(installed, made);
    if (fault.empty() && (chmod(made.c_str(), mode) != 0 || !PutInPlace(made, home))) {
        fault = std::strerror(errno);
    }
    if (fault.empty()) {
        return true;
    }
    fs::remove_all(made, error);
    // Another program of ours, for another monitor, may have been quicker.
    return fs::is_directory(home, error) || Complain(home, fault);
}

bool EnterToonHome() {
    std::error_code error;
    const fs::path home = DataHome() / "dorbo/toons";
    if (!fs::exists(fs::symlink_status(home, error))) {
        const std::string installed = FindInstalledToons(fs::read_symlink("/proc/self/exe", error));
        if (installed.empty()) {
            return Complain(home, "there is no such directory, and no Toons to put into it");
        }
        if (!MakeToonHome(installed, home)) {
            return false;
        }
    }
    fs::current_path(home, error);
    return !error || Complain(home, error.message());
}

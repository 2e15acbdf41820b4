#include "cli/play.h"

#include "cli/check.h"
#include "cli/help.h"
#include "cli/options.h"

#include "editor/editor_shell.h"
#include "launch/toon_home.h"
#include "platform/kernel.h"
#include "platform/kernel/paths.h"
#include "platform/user/toolkit.h"
#include "saver/toon_player.h"
#include "toon/settings.h"

#include <sys/mman.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <system_error>

namespace {

namespace fs = std::filesystem;

constexpr int refused = 1;

/// Says why nothing is shown: on stderr, and in a box where nobody reads that, as after a
/// double-click on a desktop, where no terminal is near.
int Refuse(const char* command, const std::string& why) {
    std::fprintf(stderr, "toon %s: %s\n", command, why.c_str());
    const bool read =
        isatty(STDIN_FILENO) != 0 || isatty(STDOUT_FILENO) != 0 || isatty(STDERR_FILENO) != 0;
    if (!read && std::getenv("DISPLAY") != nullptr) {
        MessageBoxA(nullptr, why.c_str(), "Dorbo", MB_ICONEXCLAMATION);
    }
    return refused;
}

/// Reads the names of files, of which there is one, or may be none. Gives what is wrong.
std::string ReadFile(const std::vector<std::string>& arguments, bool required, std::string& file) {
    StageArguments read;
    std::string wrong = ReadArguments(arguments, {}, read);
    if (wrong.empty() && (read.names.size() > 1 || (required && read.names.empty()))) {
        wrong = required ? "it takes one FILE.zkt" : "it takes one FILE.zkt at most";
    }
    file = read.names.empty() ? "" : read.names.front();
    return wrong;
}

// ---- Play ---------------------------------------------------------------------------------------

/// A file without a name that holds the Toon; -1 if there is no room for it.
int CopyInMemory(const Toon& toon) {
    const std::string bytes = ToonBytes(toon);
    const int file = memfd_create("toon", MFD_CLOEXEC);
    const auto size = static_cast<ssize_t>(bytes.size());
    if (file >= 0 && write(file, bytes.data(), bytes.size()) != size) {
        close(file);
        return -1;
    }
    return file;
}

/// The player takes a bare name in the current directory: here it is the copy's number among the
/// files that this process has open.
int PlayCopy(int copy) {
    if (copy < 0 || chdir("/proc/self/fd") != 0) {
        return Refuse("play", std::string("it can't be copied: ") + std::strerror(errno));
    }
    RunPlayer(GetModuleHandleA(nullptr), nullptr, std::to_string(copy).c_str());
    return PlayerWindow ? 0 : refused;
}

// ---- Edit ---------------------------------------------------------------------------------------

/// The file's path as the editor takes it; else why it can't be edited.
std::string EditorPath(const std::string& file, std::string& path) {
    Toon toon{};
    std::string why = ReadPlayable(file, toon);
    if (!why.empty() || !MayBeWritten(file)) {
        return why.empty() ? file + ": it is read-only" : why;
    }
    std::error_code error;
    const fs::path folder = fs::canonical(fs::absolute(file, error).parent_path(), error);
    path = seam::platformPath((folder / fs::path(file).filename()).native(), seam::drives());
    if (error || path.empty()) {
        return file + ": a name in its path holds a backslash";
    }
    return path.size() < TOON_PATH_SIZE ? "" : file + ": its path is longer than 255 bytes";
}

/// The first run of all notes where the user's Toons lie, which isn't where he happens to be.
void NoteToonDirectory() {
    if (SettingsNameDirectory()) {
        return;
    }
    std::error_code ignored;
    const fs::path here = fs::current_path(ignored);
    EnterToonHome();
    SettingsLoad();
    SettingsSave();
    fs::current_path(here, ignored);
}

} // namespace

int PlayToonCommand(const std::vector<std::string>& arguments) {
    std::string file;
    const std::string wrong = ReadFile(arguments, true, file);
    if (!wrong.empty()) {
        return TellWrongUsage("play", wrong);
    }
    Toon toon{};
    const std::string why = ReadPlayable(file, toon);
    if (!why.empty()) {
        return Refuse("play", why);
    }
    if (!seam::toolkit()) {
        return refused;
    }
    NoteToonDirectory();
    SettingsLoad();
    return PlayCopy(CopyInMemory(toon));
}

int EditToonCommand(const std::vector<std::string>& arguments) {
    std::string file;
    std::string path;
    const std::string wrong = ReadFile(arguments, false, file);
    if (!wrong.empty()) {
        return TellWrongUsage("edit", wrong);
    }
    const std::string why = file.empty() ? "" : EditorPath(file, path);
    if (!why.empty()) {
        return Refuse("edit", why);
    }
    if (!seam::toolkit()) {
        return refused;
    }
    NoteToonDirectory();
    return RunEditorWith(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL, path.c_str());
}

// The program `dorbo-start`: starts another program where the user's Toons lie.
#include "launch/toon_home.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <string>
#include <unistd.h>

constexpr int EXIT_USAGE = 2;
constexpr int EXIT_CANT_RUN = 126; // as a shell says it
constexpr int EXIT_NOT_FOUND = 127;

/// Where a program lies that was installed or built with this one; the bare name if there is none,
/// which is then looked for in PATH.
static std::string FindProgram(const std::string& name) {
    namespace fs = std::filesystem;
    std::error_code error;
    const fs::path here = fs::read_symlink("/proc/self/exe", error).parent_path();
    for (const char* place : {"../../bin", "..", "../cli"}) { // installed, or in the build tree
        const fs::path program = (here / place / name).lexically_normal();
        if (!error && name.find('/') == std::string::npos && fs::is_regular_file(program, error)) {
            return program;
        }
        error.clear();
    }
    return name;
}

int main(int count, char** words) {
    if (count < 2) {
        std::fputs("usage: dorbo-start PROGRAM [ARGUMENTS]\n\n"
                   "Starts the program in the directory of your Toons, which it makes if there is "
                   "none.\n",
                   stderr);
        return EXIT_USAGE;
    }
    const std::string program = FindProgram(words[1]);
    EnterToonHome();
    execvp(program.c_str(), words + 1);
    std::fprintf(stderr, "dorbo-start: can't run %s: %s\n", words[1], std::strerror(errno));
    return errno == ENOENT ? EXIT_NOT_FOUND : EXIT_CANT_RUN;
}

// The program `toon`: what can be done with Toon files.
#include "cli/check.h"
#include "cli/film.h"
#include "cli/help.h"
#include "cli/play.h"
#include "cli/show_write.h"
#include "cli/trace.h"

#include <algorithm>
#include <cstdio>
#include <limits>
#include <string>
#include <vector>

namespace {

using Arguments = std::vector<std::string>;

constexpr std::size_t anyNumber = std::numeric_limits<std::size_t>::max();

struct Command {
    const char* name;
    std::size_t fewest; // arguments behind the name
    std::size_t most;
    int (*run)(const Arguments& arguments); // gives the exit code
};

constexpr Command commands[] = {
    {"play", 0, anyNumber, PlayToonCommand}, // those without a number count for themselves
    {"edit", 0, anyNumber, EditToonCommand}, {"show", 1, 1, ShowCommand},
    {"write", 1, 3, WriteCommand},           {"check", 1, anyNumber, CheckCommand},
    {"film", 0, anyNumber, FilmCommand},     {"trace", 0, anyNumber, TraceCommand},
};

bool asksForHelp(const Arguments& arguments) {
    return std::any_of(arguments.begin(), arguments.end(), [](const std::string& argument) {
        return argument == "--help" || argument == "-h";
    });
}

int Run(const Command& command, const Arguments& arguments) {
    if (asksForHelp(arguments)) {
        PrintHelp(command.name);
        return 0;
    }
    if (arguments.size() < command.fewest || arguments.size() > command.most) {
        return TellWrongUsage(command.name, "");
    }
    return command.run(arguments);
}

} // namespace

int main(int count, char** words) {
    const Arguments all(words + std::min(count, 1), words + count);
    const std::string name = all.empty() ? "" : all.front();
    for (const Command& command : commands) {
        if (name == command.name) {
            return Run(command, {all.begin() + 1, all.end()});
        }
    }
    if (asksForHelp({name})) {
        PrintHelp("");
        return 0;
    }
    constexpr int usageError = 2;
    std::fprintf(stderr, "toon: %s%s\nTry: toon --help\n",
                 all.empty() ? "which command?" : "there is no command ", name.c_str());
    return usageError;
}

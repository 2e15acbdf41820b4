// The program `toon`: what can be done with Toon files without a screen.
#include "cli/check.h"
#include "cli/replay.h"
#include "cli/show_write.h"

#include <climits>
#include <cstdio>
#include <string>
#include <vector>

namespace {

struct Command {
    const char* name;
    const char* usage;
    int fewest; // arguments behind the name
    int most;
    int (*run)(const std::vector<std::string>& arguments); // gives the exit code
};

constexpr Command commands[] = {
    {"show", "FILE.zkt", 1, 1, ShowCommand},
    {"write", "FILE.json [-o FILE.zkt]", 1, 3, WriteCommand},
    {"check", "[--json] FILE...", 1, INT_MAX, CheckCommand},
    {"trace", "[--size WxH] [--seed N] [--shows N] [--paces N] [FILE.zkt...]", 0, 1000,
     TraceCommand},
};

int TellUsage() {
    for (const Command& command : commands) {
        std::fprintf(stderr, "usage: toon %s %s\n", command.name, command.usage);
    }
    return 2;
}

} // namespace

int main(int count, char** arguments) {
    constexpr int inFront = 2; // the program's name and the command's
    const int behind = count - inFront;
    for (const Command& command : commands) {
        if (behind >= command.fewest && behind <= command.most &&
            command.name == std::string(arguments[1])) {
            return command.run({arguments + inFront, arguments + count});
        }
    }
    return TellUsage();
}

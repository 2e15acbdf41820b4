#include "cli/help.h"

#include <cstdio>

namespace {

struct Help {
    const char* name;
    const char* arguments;
    const char* summary;
    const char* text; // what follows the usage
};

constexpr const char* overview =
    "\n"
    "A Toon is a little play for Dorbo: frames that say where he walks, which pose he strikes, "
    "what he\n"
    "says and how long he stays. The saver plays the .zkt files of one directory.\n"
    "\n"
    "  Begin with one that is there:     toon show intro.zkt > mine.json\n"
    "  Change mine.json, make it whole:  toon write mine.json\n"
    "  See what the saver makes of it:   toon check mine.zkt\n"
    "  Watch it:                         toon play mine.zkt\n"
    "  Send it to a friend:              toon film mine.zkt mine.gif\n"
    "\n"
    "`toon COMMAND --help` tells more of each. Exit code: 0 done, 1 something is wrong with a "
    "file,\n"
    "2 the command line is.\n";

constexpr Help helps[] = {
    {"play", "FILE.zkt", "shows a Toon on the whole screen, once",
     "\n"
     "A key or a click ends it. The file may have any name, and may be read-only.\n"
     "\n"
     "  toon play intro.zkt\n"},
    {"edit", "[FILE.zkt]", "opens the Toon editor",
     "\n"
     "With a file that Toon is open in it from the start: Alt+P plays it, Ctrl+E edits its "
     "frames.\n"
     "\n"
     "  toon edit\n"
     "  toon edit mine.zkt\n"},
    {"show", "FILE.zkt", "prints a Toon as JSON",
     "\n"
     "Poses count from 1. In texts \\n is the line break of a bubble; \\r stands for a line feed, "
     "which\n"
     "no editor of Toons writes. What is printed can be turned back by `toon write`.\n"
     "\n"
     "  toon show intro.zkt                    look at it\n"
     "  toon show intro.zkt > intro.json       keep it where it can be changed\n"
     "  diff <(toon show a.zkt) <(toon show b.zkt)\n"},
    {"write", "FILE.json [-o FILE.zkt]", "makes a Toon of JSON",
     "\n"
     "  -o FILE.zkt   where to; else beside the source, with .zkt for .json\n"
     "\n"
     "An error names the file, the line, the frame and the field, and what would be right. Nothing "
     "is\n"
     "written then.\n"
     "\n"
     "  toon write mine.json                   makes mine.zkt\n"
     "  toon write mine.json -o ~/toons/x.zkt\n"},
    {"check", "[--json] FILE.zkt...", "tells what the saver would do with Toons",
     "\n"
     "  --json   the same for programs: an array with an object for each file\n"
     "\n"
     "A line each: how many frames and seconds, or what is out of range, what would stand still "
     "for\n"
     "ever, what can't be played. Exit code 1 if anything is wrong.\n"
     "\n"
     "  toon check *.zkt\n"
     "  toon check --json *.zkt | jq '.[] | select(.findings != [])'\n"},
    {"film", "FILE.zkt OUT | --walk-about OUT [--size WxH] [--seed N] [--mode WHO] [--still MS]",
     "acts a Toon out and films it, without a screen",
     "\n"
     "  OUT           .gif, .png (animated), or a directory for numbered pictures\n"
     "  --size WxH    the stage in pixels; 1024x768 if not told\n"
     "  --seed N      of the random numbers; the same film for the same seed\n"
     "  --mode WHO    who shows it: saver (if not told) or player\n"
     "  --walk-about  films a walk about, in the place of a Toon\n"
     "  --still MS    the one picture that stands MS milliseconds after the start\n"
     "\n"
     "  toon film intro.zkt intro.gif\n"
     "  toon film intro.zkt intro.png --size 640x480\n"
     "  toon film intro.zkt title.png --still 1000\n"},
    {"trace",
     "FILE.zkt... | --walk-about [--size WxH] [--seed N] [--mode WHO] [--script FILE] [--shows N] "
     "[--paces N]",
     "prints what happens in a show, to the millisecond",
     "\n"
     "  --size WxH    the stage in pixels; 1024x768 if not told\n"
     "  --seed N      of the random numbers; the same show for the same seed\n"
     "  --mode WHO    who shows it: saver (if not told), player or editor\n"
     "  --script FILE what a user does in the editor; the Toons are there to be opened\n"
     "  --walk-about  traces walks about, in the place of Toons\n"
     "  --shows N     after how many shows the stage closes; 1 if not told\n"
     "  --paces N     the odometer at the start\n"
     "\n"
     "docs/trace.md tells what the lines mean.\n"
     "\n"
     "  toon trace intro.zkt\n"
     "  toon trace intro.zkt --size 1920x1080 | grep ' walk '\n"
     "  toon trace --walk-about --seed 7 --shows 5\n"
     "  toon trace --mode editor --script my.scene intro.zkt\n"},
};

const Help* find(const std::string& command) {
    for (const Help& help : helps) {
        if (command == help.name) {
            return &help;
        }
    }
    return nullptr;
}

} // namespace

bool PrintHelp(const std::string& command) {
    if (command.empty()) {
        std::puts("usage: toon COMMAND ARGUMENTS\n");
        for (const Help& help : helps) {
            std::printf("  toon %-6s %s\n", help.name, help.summary);
        }
        std::fputs(overview, stdout);
        return true;
    }
    const Help* help = find(command);
    if (help == nullptr) {
        return false;
    }
    std::printf("usage: toon %s %s\n\n%s.\n%s", help->name, help->arguments, help->summary,
                help->text);
    return true;
}

int TellWrongUsage(const std::string& command, const std::string& wrong) {
    constexpr int wrongUsage = 2;
    if (!wrong.empty()) {
        std::fprintf(stderr, "toon %s: %s\n", command.c_str(), wrong.c_str());
    }
    const Help* help = find(command);
    std::fprintf(stderr, "usage: toon %s %s\n", command.c_str(),
                 help == nullptr ? "" : help->arguments);
    return wrongUsage;
}

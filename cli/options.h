// What the command lines of `toon film` and `toon trace` have in common.
#pragma once

#include "cli/replay.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

struct StageArguments {
    ReplayOptions stage;
    bool walkAbout = false;
    std::optional<std::int64_t> still; // ms
    std::string script;                // file of a scene
    std::vector<std::string> names;    // what is no option, in its order
};

/// One option that a command takes. Its value stands behind it, as in `--seed 7` or `--seed=7`.
struct Option {
    const char* name;
    const char* takes; // what its value may be, for the user; null if it takes none
    bool (*read)(const std::string& value, StageArguments& arguments); // false: not such a value
};

// --size WxH, --seed N, --shows N, --paces N, --still MS, --mode WHO, --script FILE, --walk-about
extern const Option optionSize;
extern const Option optionSeed;
extern const Option optionShows;
extern const Option optionPaces;
extern const Option optionStill;
extern const Option optionMode;
extern const Option optionTraceMode; // --mode, which knows the editor too
extern const Option optionScript;
extern const Option optionWalkAbout;

/// Reads a command line with these options, in any order and place; what stands behind `--` is no
/// option. Gives what is wrong with it, for the user; empty if nothing is.
std::string ReadArguments(const std::vector<std::string>& line, const std::vector<Option>& options,
                          StageArguments& arguments);

/// Says on stderr what is wrong with a command line and how it is used; gives the exit code.
int TellWrongUsage(const char* command, const std::string& wrong, const char* usage);

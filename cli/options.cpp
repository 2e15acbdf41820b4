#include "cli/options.h"

#include <algorithm>
#include <charconv>
#include <cstdio>
#include <limits>

namespace {

/// Reads a decimal number that is all of the text and lies within the bounds.
template <class Number>
bool readNumber(const std::string& text, Number lowest, Number highest, Number& number) {
    Number read{};
    const char* end = text.data() + text.size();
    const auto [stopped, error] = std::from_chars(text.data(), end, read);
    if (error != std::errc() || stopped != end || read < lowest || read > highest) {
        return false;
    }
    number = read;
    return true;
}

bool readSize(const std::string& value, StageArguments& arguments) {
    constexpr int largestSide = 8192; // pixels: beyond it pictures fill the memory
    const auto cross = value.find('x');
    return cross != std::string::npos &&
           readNumber(value.substr(0, cross), 1, largestSide, arguments.stage.width) &&
           readNumber(value.substr(cross + 1), 1, largestSide, arguments.stage.height);
}

constexpr auto largestCount = std::numeric_limits<std::uint32_t>::max();

bool readSeed(const std::string& value, StageArguments& arguments) {
    return readNumber(value, 0U, largestCount, arguments.stage.seed);
}

bool readPaces(const std::string& value, StageArguments& arguments) {
    return readNumber(value, 0U, largestCount, arguments.stage.paces);
}

bool readShows(const std::string& value, StageArguments& arguments) {
    return readNumber(value, 1, std::numeric_limits<int>::max(), arguments.stage.shows);
}

bool readStill(const std::string& value, StageArguments& arguments) {
    constexpr std::int64_t longest = std::numeric_limits<std::int32_t>::max();
    return readNumber(value, std::int64_t{0}, longest, arguments.still.emplace());
}

bool readMode(const std::string& value, StageArguments& arguments) {
    const bool player = value == "player";
    arguments.stage.mode = player ? ReplayMode::player : ReplayMode::saver;
    return player || value == "saver";
}

bool readTraceMode(const std::string& value, StageArguments& arguments) {
    if (value != "editor") {
        return readMode(value, arguments);
    }
    arguments.stage.mode = ReplayMode::editor;
    return true;
}

bool readScript(const std::string& value, StageArguments& arguments) {
    arguments.script = value;
    return !value.empty();
}

bool readWalkAbout(const std::string& /*value*/, StageArguments& arguments) {
    arguments.walkAbout = true;
    return true;
}

/// The option of which the text is the name, or the name and the value.
const Option* findOption(const std::vector<Option>& options, const std::string& name) {
    const auto found =
        std::ranges::find_if(options, [&](const Option& option) { return name == option.name; });
    return found == options.end() ? nullptr : &*found;
}

/// Reads the option at `place`, which is moved to the last argument that belongs to it.
std::string readOption(const std::vector<std::string>& line, std::size_t& place,
                       const std::vector<Option>& options, StageArguments& arguments) {
    const std::size_t equals = line[place].find('=');
    const std::string name = line[place].substr(0, equals);
    const Option* option = findOption(options, name);
    if (option == nullptr) {
        return name + " is no option here";
    }
    const bool joined = equals != std::string::npos;
    if (option->takes == nullptr) {
        return joined || !option->read("", arguments) ? name + " takes no value" : "";
    }
    if (!joined && place + 1 == line.size()) {
        return name + " takes " + option->takes;
    }
    const std::string value = joined ? line[place].substr(equals + 1) : line[++place];
    return option->read(value, arguments) ? ""
                                          : name + " takes " + option->takes + ", not " + value;
}

} // namespace

const Option optionSize = {"--size", "a width and a height of 1 to 8192, as in 1024x768", readSize};
const Option optionSeed = {"--seed", "a number of 0 to 4294967295", readSeed};
const Option optionShows = {"--shows", "a number from 1 on", readShows};
const Option optionPaces = {"--paces", "a number of 0 to 4294967295", readPaces};
const Option optionStill = {"--still", "a moment in milliseconds from 0 on", readStill};
const Option optionMode = {"--mode", "saver or player", readMode};
const Option optionTraceMode = {"--mode", "saver, player or editor", readTraceMode};
const Option optionScript = {"--script", "a file", readScript};
const Option optionWalkAbout = {"--walk-about", nullptr, readWalkAbout};

std::string ReadArguments(const std::vector<std::string>& line, const std::vector<Option>& options,
                          StageArguments& arguments) {
    bool optionsOver = false;
    for (std::size_t place = 0; place < line.size(); ++place) {
        if (optionsOver || line[place].size() < 2 || line[place][0] != '-') {
            arguments.names.push_back(line[place]);
        } else if (line[place] == "--") {
            optionsOver = true;
        } else {
            std::string wrong = readOption(line, place, options, arguments);
            if (!wrong.empty()) {
                return wrong;
            }
        }
    }
    return "";
}

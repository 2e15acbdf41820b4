// Any bytes for the command lines: the saver's, which runs what it asks for, and the options of
// `toon` and `dorbo-hack`, which are read only, as the lines of a scene are. A line break parts the
// words of a line, and an @ stands for a window that is there.
#include "cli/options.h"
#include "cli/scene.h"
#include "launch/hack_options.h"
#include "platform/harness.h"
#include "platform/kernel.h"
#include "saver/saver_guard.h"
#include "saver/saver_main.h"
#include "tests/fuzz/fuzz.h"
#include "tests/fuzz/user.h"

#include <sstream>
#include <stdexcept>

namespace {

using Words = std::vector<std::string>;

Words wordsOf(std::string_view text) {
    Words words;
    std::istringstream in{std::string(text)};
    for (std::string word; std::getline(in, word);) {
        words.push_back(word.substr(0, word.find('\0'))); // as a process gets them
    }
    return words;
}

// ---- The saver ----------------------------------------------------------------------------------

constexpr std::string_view looksOn = ".5"; // for some steps of a show, then leaves
constexpr const char* hostClass = "FuzzedHost";

/// Runs what the line asks for as the process does, with the name that it was called by.
void runSaver(Words words) {
    const HWND host = CreateWindowExA(0, hostClass, "", WS_VISIBLE | WS_POPUP, 0, 0, 160, 120,
                                      nullptr, nullptr, HINSTANCE{}, nullptr);
    std::vector<const char*> arguments{"dorbo"};
    for (std::string& word : words) {
        if (const std::size_t at = word.find('@'); at != std::string::npos) {
            word.replace(at, 1, std::to_string(host.number));
        }
        arguments.push_back(word.c_str());
    }
    SaverWindow = nullptr;
    SetCommandLineArguments(static_cast<int>(arguments.size()), arguments.data());
    const int code = ProcessStart();
    seam::forgetClass(SAVER_CLASS); // a process runs one saver
    demand(code == 0 || code == 1 || code == -1);
    DestroyWindow(host);
}

// ---- The other programs -------------------------------------------------------------------------

void readToonOptions(const Words& words) {
    StageArguments read;
    const std::vector<Option> all{optionSize,  optionSeed,      optionShows,  optionPaces,
                                  optionStill, optionTraceMode, optionScript, optionWalkAbout};
    if (ReadArguments(words, all, read).empty()) {
        demand(read.stage.width >= 1 && read.stage.width <= 8192);
        demand(read.stage.height >= 1 && read.stage.height <= 8192);
        demand(read.stage.shows >= 1);
        demand(!read.still || *read.still >= 0);
        demand(read.names.size() <= words.size());
    }
}

void readHackOptions(const Words& words) {
    const char* variable = words.empty() ? nullptr : words.front().c_str();
    for (const char* named : {variable, static_cast<const char*>(nullptr)}) {
        const HackRequest request = ReadHackArguments(words, named);
        demand((request.target == HackTarget::WINDOW) == (request.window != 0));
        demand(request.window <= 0x1FFFFFFF);
        const bool fails =
            request.target == HackTarget::WRONG || request.target == HackTarget::NOWHERE;
        demand(fails == !request.complaint.empty());
    }
}

void readScene(std::string_view text) {
    std::istringstream in{std::string(text)};
    try {
        std::int64_t before = 0;
        for (const SceneStep& step : ReadScene(in, "scene")) {
            demand(step.moment >= before && step.act != nullptr);
            before = step.moment;
        }
    } catch (const std::runtime_error& error) {
        demand(std::string(error.what()).starts_with("scene:"));
    }
}

} // namespace

void prepare() {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = DefWindowProcA;
    windowClass.lpszClassName = hostClass;
    RegisterClassA(&windowClass);
    for (const char* line : {"S", "C", "P @", "A"}) {
        fuzz::runWithUser(looksOn, [&] { runSaver({line}); });
    }
}

void tryInput(std::string_view bytes) {
    const Words words = wordsOf(bytes);
    readToonOptions(words);
    readHackOptions(words);
    readScene(bytes);
    fuzz::runWithUser(looksOn, [&] { runSaver(words); });
}

#include "cli/replay.h"

#include "platform/harness.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "saver/saver_guard.h"
#include "saver/saver_main.h"
#include "saver/show_cycle.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/stage.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

#include <charconv>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <limits>
#include <stdexcept>

namespace {

namespace fs = std::filesystem;

constexpr const char* replayClass = "ReplayClass";

std::function<void(const std::string&)> lineSink;
int showsLeft = 0;
int showsDone = 0;

constexpr const char* homeVariable = "XDG_CONFIG_HOME";

/// The saver's procedure, but that the stage closes at the end of the last show. The first walk
/// about tells of its end twice; it is over when the second message comes.
LRESULT replayProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == TM_SHOWDONE && RandomWalkActive == 0) {
        ++showsDone;
        if (--showsLeft <= 0) {
            DestroyWindow(window);
            return 0;
        }
    }
    return SaverGuardProc(window, message, wParam, lParam);
}

HWND createStage(const ReplayOptions& options) {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = replayProc;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = replayClass;
    RegisterClassA(&windowClass); // refused, and none the worse, from the second replay on
    return CreateWindowExA(0, replayClass, "", WS_POPUP | WS_VISIBLE, 0, 0, options.width,
                           options.height, nullptr, nullptr, windowClass.hInstance, nullptr);
}

void setStartSettings(const ReplayOptions& options) {
    WalkingStyle = options.toons.empty() ? 0 : 1;
    Statements = options.statements ? 1 : 0;
    Backgrounds = 1;
    PacesWalked = options.paces;
    Directory[0] = '\0';
    GetCurrentDirectoryA(sizeof Directory, Directory);
    SettingsSave();
}

} // namespace

ReplayGround::ReplayGround() : before_(fs::current_path()) {
    std::string pattern = fs::canonical(fs::temp_directory_path()) / "dorbo-replay-XXXXXX";
    if (mkdtemp(pattern.data()) == nullptr) {
        throw std::runtime_error("no directory for the replay can be made");
    }
    root_ = pattern;
    if (const char* home = std::getenv(homeVariable)) {
        homeBefore_ = home;
    }
    fs::create_directories(root_ / "home");
    fs::create_directories(root_ / "toons");
    setenv(homeVariable, (root_ / "home").c_str(), 1);
    fs::current_path(root_ / "toons");
}

ReplayGround::~ReplayGround() {
    std::error_code ignored;
    fs::current_path(before_, ignored);
    fs::remove_all(root_, ignored);
    if (homeBefore_) {
        setenv(homeVariable, homeBefore_->c_str(), 1);
    } else {
        unsetenv(homeVariable);
    }
}

void ForgetEarlierStages() {
    ToonDocHeader = {};
    ToonFileName[0] = '\0';
    CaptionText[0] = '\0';
    ToonSpeed = 3;
    BackgroundIndex = 0;
    PlayFrame = {};
    WalkFrame = {};
    LastMouthShape = 0;
    PreviousStatement = 0;
    NextToonFile[0] = '\0';
    ToonFileCount = 0;
    BackgroundCount = 0;
    LastBackground = 0;
    StageRepaintFlag = 1;
    PreviewMode = 0;
    SaverVerifying = 0;
    SaverClosing = 0;
}

void Replay(const ReplayOptions& options, const std::function<void(const std::string&)>& line) {
    const ReplayGround ground;
    for (const std::string& toon : options.toons) {
        fs::copy_file(toon, ground.toons() / fs::path(toon).filename());
    }
    ForgetEarlierStages();
    setStartSettings(options);
    lineSink = line;
    showsLeft = options.shows;
    showsDone = 0;
    seam::useManualClock(options.seed);
    seam::answerBoxes([](const std::string&, const std::string&, UINT) { return IDOK; });
    TraceStart();
    TraceSink = [](const char* event) { lineSink(event); };
    const HWND stage = createStage(options);
    auto due = seam::nextDeadline();
    while (due && *due <= options.longest && seam::runUntil(*due)) {
        due = seam::nextDeadline();
    }
    DestroyWindow(stage);
    Trace("end odometer=%u shows=%d", PacesWalked, showsDone);
    seam::runUntil(seam::clockNow()); // takes the quit that the window's end has posted
    TraceSink = nullptr;
    seam::answerBoxes(nullptr);
}

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

/// Reads one option with its value; false if it is none that we know.
bool readOption(const std::string& name, const std::string& value, ReplayOptions& options) {
    constexpr int largestSide = 0x7FFF;
    if (name == "--size") {
        const auto cross = value.find('x');
        return cross != std::string::npos &&
               readNumber(value.substr(0, cross), 1, largestSide, options.width) &&
               readNumber(value.substr(cross + 1), 1, largestSide, options.height);
    }
    if (name == "--shows") {
        return readNumber(value, 1, std::numeric_limits<int>::max(), options.shows);
    }
    constexpr auto largest = std::numeric_limits<std::uint32_t>::max();
    if (name == "--seed") {
        return readNumber(value, 0U, largest, options.seed);
    }
    return name == "--paces" && readNumber(value, 0U, largest, options.paces);
}

} // namespace

int TraceCommand(const std::vector<std::string>& arguments) {
    ReplayOptions options;
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        if (arguments[i].rfind("--", 0) != 0) {
            options.toons.push_back(fs::absolute(arguments[i]));
        } else if (i + 1 == arguments.size() ||
                   !readOption(arguments[i], arguments[i + 1], options)) {
            std::fprintf(stderr, "toon trace: %s is no option with a value that can be used\n",
                         arguments[i].c_str());
            return 2;
        } else {
            ++i;
        }
    }
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    try {
        Replay(options, [](const std::string& event) { std::puts(event.c_str()); });
    } catch (const std::exception& error) {
        std::fprintf(stderr, "toon trace: %s\n", error.what());
        return 1;
    }
    return 0;
}

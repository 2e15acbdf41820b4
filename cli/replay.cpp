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

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <stdexcept>

namespace {

namespace fs = std::filesystem;

constexpr const char* replayClass = "ReplayClass";
constexpr std::int64_t stepTime = 1000; // how far the clock goes between two looks for an end

std::function<void(const std::string&)> lineSink;
int showsLeft = 0;
int showsDone = 0;

/// A directory with the Toons and a home for the settings, entered while it lives.
class Ground {
  public:
    explicit Ground(const std::vector<std::string>& toons) {
        std::string pattern = fs::temp_directory_path() / "toon-trace-XXXXXX";
        if (mkdtemp(pattern.data()) == nullptr) {
            throw std::runtime_error("no directory for the replay can be made");
        }
        root_ = pattern;
        fs::create_directories(root_ / "home");
        fs::create_directories(root_ / "toons");
        for (const std::string& toon : toons) {
            fs::copy_file(toon, root_ / "toons" / fs::path(toon).filename());
        }
        setenv("XDG_CONFIG_HOME", (root_ / "home").c_str(), 1);
        fs::current_path(root_ / "toons");
    }

    Ground(const Ground&) = delete;
    Ground& operator=(const Ground&) = delete;

    ~Ground() {
        std::error_code ignored;
        fs::current_path(before_, ignored);
        fs::remove_all(root_, ignored);
    }

  private:
    fs::path before_ = fs::current_path();
    fs::path root_;
};

/// The saver's procedure, but that the stage closes at the end of the last show.
LRESULT replayProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == TM_SHOWDONE) {
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

/// What outlives a stage, as it stands in a fresh process: a replay doesn't depend on the one
/// before it.
void forgetEarlierStages() {
    ToonDocHeader = {};
    PlayFrame = {};
    WalkFrame = {};
    CaptionText[0] = '\0';
    ToonSpeed = 3;
    LastMouthShape = 0;
    PreviousStatement = 0;
    LastBackground = 0;
    StageRepaintFlag = 1;
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

void Replay(const ReplayOptions& options, const std::function<void(const std::string&)>& line) {
    const Ground ground(options.toons);
    forgetEarlierStages();
    setStartSettings(options);
    lineSink = line;
    showsLeft = options.shows;
    showsDone = 0;
    seam::useManualClock(options.seed);
    seam::answerBoxes([](const std::string&, const std::string&, UINT) { return IDOK; });
    TraceStart();
    TraceSink = [](const char* event) { lineSink(event); };
    const HWND stage = createStage(options);
    while (IsWindow(stage) && seam::liveHandles().timers > 0 &&
           seam::runUntil(seam::clockNow() + stepTime)) {
    }
    DestroyWindow(stage);
    Trace("end odometer=%u shows=%d", PacesWalked, showsDone);
    seam::runUntil(seam::clockNow()); // takes the quit that the window's end has posted
    TraceSink = nullptr;
    seam::answerBoxes(nullptr);
}

namespace {

/// Reads one option with its value; false if it is none that we know.
bool readOption(const std::string& name, const std::string& value, ReplayOptions& options) {
    if (name == "--size") {
        return std::sscanf(value.c_str(), "%dx%d", &options.width, &options.height) == 2 &&
               options.width > 0 && options.height > 0 && options.width <= 0x7FFF &&
               options.height <= 0x7FFF;
    }
    if (name == "--shows") {
        return std::sscanf(value.c_str(), "%d", &options.shows) == 1;
    }
    if (name == "--seed") {
        return std::sscanf(value.c_str(), "%u", &options.seed) == 1;
    }
    return name == "--paces" && std::sscanf(value.c_str(), "%u", &options.paces) == 1;
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

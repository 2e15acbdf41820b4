#include "cli/replay.h"

#include "editor/editor_shell.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "saver/saver_guard.h"
#include "saver/saver_main.h"
#include "saver/show_cycle.h"
#include "saver/toon_player.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/stage.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <stdexcept>
#include <strings.h>
#include <system_error>

namespace {

namespace fs = std::filesystem;

constexpr const char* replayClass = "ReplayClass";

const ReplayHooks* hooked = nullptr; // those of the replay under way
ReplayMode mode = ReplayMode::saver;
int showsLeft = 0;
int showsDone = 0;

constexpr const char* homeVariable = "XDG_CONFIG_HOME";
constexpr const char* runtimeVariable = "XDG_RUNTIME_DIR";

/// The procedure of who shows it, but that the stage closes at the end of the last show. The first
/// walk about tells of its end twice: to the saver it is over when the second message comes, to the
/// player at once.
LRESULT replayProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    const bool plays = mode == ReplayMode::player;
    if (message == TM_SHOWDONE && (RandomWalkActive == 0 || plays)) {
        ++showsDone;
        if (--showsLeft <= 0) {
            DestroyWindow(window);
            return 0;
        }
    }
    return plays ? PlayerProc(window, message, wParam, lParam)
                 : SaverGuardProc(window, message, wParam, lParam);
}

/// The editor's windows have procedures of their own, and its shows only the record to tell of
/// their ends.
void tellLine(const char* event) {
    const std::string line = event;
    if (mode == ReplayMode::editor && line.ends_with(" show_done") && RandomWalkActive == 0) {
        ++showsDone;
    }
    if (hooked->line) {
        hooked->line(line);
    }
}

HWND createEditor() {
    const HINSTANCE instance = GetModuleHandleA(nullptr);
    EditorClassSetup(instance); // refused from the second replay on
    CreateEditorWindows(instance, SW_SHOWNORMAL);
    return EditorMainWindow;
}

HWND createStage(const ReplayOptions& options) {
    if (options.mode == ReplayMode::editor) {
        return createEditor();
    }
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = replayProc;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = replayClass;
    RegisterClassA(&windowClass); // refused, and none the worse, from the second replay on
    return CreateWindowExA(0, replayClass, "", WS_POPUP | WS_VISIBLE, 0, 0, options.width,
                           options.height, nullptr, nullptr, windowClass.hInstance, nullptr);
}

/// The player is told what to play once its window stands.
void chooseToon(const std::vector<std::string>& names) {
    if (mode == ReplayMode::player && !names.empty()) {
        CopyText(NextToonFile, names.front().c_str(), NEXT_TOON_SIZE);
    }
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
    if (std::getenv(runtimeVariable) == nullptr) {
        lentRuntime_ = true; // the toolkit complains where there is none
        setenv(runtimeVariable, root_.c_str(), 1);
    }
    fs::current_path(root_ / "toons");
}

ReplayGround::~ReplayGround() {
    std::error_code ignored;
    fs::current_path(before_, ignored);
    fs::remove_all(root_, ignored);
    if (lentRuntime_) {
        unsetenv(runtimeVariable);
    }
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
    PreviewMode = PREVIEW_NONE;
    SaverVerifying = 0;
    SaverClosing = 0;
}

namespace {

/// The name under which the saver finds a Toon, whatever its file is called.
fs::path playedName(const fs::path& toon) {
    const bool found = strcasecmp(toon.extension().c_str(), ".zkt") == 0 &&
                       toon.filename().native().size() < NEXT_TOON_SIZE;
    return found ? toon.filename() : "toon.zkt";
}

/// Gives the names that the copies have.
std::vector<std::string> copyToons(const ReplayOptions& options, const fs::path& before,
                                   const fs::path& target) {
    std::vector<std::string> names;
    for (const std::string& toon : options.toons) {
        std::error_code error;
        const fs::path copy =
            target / (options.anyName ? playedName(toon) : fs::path(toon).filename());
        fs::copy_file(before / toon, copy, error);
        if (error == std::errc::file_exists) {
            throw std::runtime_error(toon + ": another Toon has this name already");
        }
        if (error) {
            throw std::runtime_error(toon + ": " + error.message());
        }
        // The saver would refuse one that it may not write, and wait with a box.
        fs::permissions(copy, fs::perms::owner_read | fs::perms::owner_write, error);
        names.push_back(copy.filename());
    }
    return names;
}

/// A stage whose shows are told of, up to its end, however that comes.
class ToldStage {
  public:
    ToldStage(const ReplayOptions& options, const ReplayHooks& hooks, ReplayEnd& end) {
        hooked = &hooks;
        if (hooks.line || options.mode == ReplayMode::editor) {
            TraceSink = tellLine;
        }
        if (hooks.picture) {
            seam::watchPictures([&](HWND, const RECT& drawn, const seam::PixelView& picture) {
                hooks.picture(seam::clockNow(), drawn, picture);
            });
        }
        seam::answerBoxes([&end](const std::string& text, const std::string&, UINT) {
            end.message = end.message.empty() ? text : end.message;
            return IDOK;
        });
        seam::answerFileDialogs([](const std::string&) { return std::nullopt; });
        stage_ = createStage(options);
    }

    ToldStage(const ToldStage&) = delete;
    ToldStage& operator=(const ToldStage&) = delete;

    ~ToldStage() {
        close();
        TraceSink = nullptr;
        seam::watchPictures(nullptr);
        seam::answerBoxes(nullptr);
        seam::answerFileDialogs(nullptr);
        hooked = nullptr;
    }

    bool stands() const {
        return IsWindow(stage_) != FALSE;
    }

    void close() {
        if (stands()) {
            DestroyWindow(stage_);
        }
    }

  private:
    HWND stage_;
};

/// Does a step of a scene at its moment; false if the stage has closed, or mustn't go on.
bool actStep(const SceneStep& step, const ReplayHooks& hooks) {
    auto due = seam::nextDeadline();
    while (due && *due <= step.moment) {
        if ((hooks.goesOn && !hooks.goesOn()) || !seam::runUntil(*due)) {
            return false;
        }
        due = seam::nextDeadline();
    }
    if (!seam::runUntil(step.moment)) {
        return false;
    }
    step.act();
    return seam::runUntil(step.moment);
}

/// Goes from one moment at which something happens to the next one, as far as it may.
void act(const ReplayOptions& options, const ReplayHooks& hooks) {
    bool stands = std::ranges::all_of(options.scene,
                                      [&](const SceneStep& step) { return actStep(step, hooks); });
    auto due = seam::nextDeadline();
    while (stands && due && *due <= options.longest && (!hooks.goesOn || hooks.goesOn())) {
        stands = seam::runUntil(*due);
        due = seam::nextDeadline();
    }
    if (stands && due && *due > options.longest) {
        seam::runUntil(options.longest);
    }
}

} // namespace

ReplayEnd Replay(const ReplayOptions& options, const ReplayHooks& hooks) {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);              // whatever the user's desktop is
    setenv("DORBO_SCALE", "1", 1);                          // and however dense its screen
    setenv("QT_LOGGING_RULES", "default.warning=false", 0); // of what that platform can't do
    const fs::path before = fs::current_path();
    const ReplayGround ground;
    const std::vector<std::string> names = copyToons(options, before, ground.toons());
    ForgetEarlierStages();
    setStartSettings(options);
    mode = options.mode;
    showsLeft = options.shows;
    showsDone = 0;
    seam::useManualClock(options.seed);
    TraceStart();
    ReplayEnd end;
    ToldStage stage(options, hooks, end);
    if (!stage.stands()) {
        throw std::runtime_error("there is no room for a stage of this size");
    }
    chooseToon(names);
    act(options, hooks);
    stage.close();
    Trace("end odometer=%u shows=%d", PacesWalked, showsDone);
    end.moment = seam::clockNow();
    end.shows = showsDone;
    seam::runUntil(end.moment); // takes the quit that the window's end has posted
    return end;
}

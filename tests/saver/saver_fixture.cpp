#include "tests/saver/saver_fixture.h"

#include "platform/trace.h"
#include "saver/saver_guard.h"
#include "saver/show_cycle.h"
#include "stage/backdrop.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/stage.h"
#include "toon/settings.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>

namespace {

namespace fs = std::filesystem;

constexpr const char* homeVariable = "XDG_CONFIG_HOME";
constexpr const char* stageClass = "SaverTestClass";

std::vector<std::string> record;

void registerClass() {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = SaverGuardProc;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = stageClass;
    RegisterClassA(&windowClass); // refused, and none the worse, from the second test on
}

/// What outlives a stage, as it stands in a fresh process.
void forgetEarlierStages() {
    ToonDocHeader = {};
    PlayFrame = {};
    WalkFrame = {};
    CaptionText[0] = '\0';
    ToonSpeed = 3;
    PreviousStatement = 0;
    NextToonFile[0] = '\0';
    ToonFileCount = 0;
    BackgroundCount = 0;
    BackgroundIndex = 0;
    LastBackground = 0;
    StageRepaintFlag = 1;
    PreviewMode = 0;
}

void setSettings() {
    WalkingStyle = 1;
    Statements = 1;
    Backgrounds = 1;
    PacesWalked = 100;
    Directory[0] = '\0';
    GetCurrentDirectoryA(sizeof Directory, Directory);
}

} // namespace

void SaverTest::SetUp() {
    std::string pattern = fs::canonical(fs::temp_directory_path()) / "dorbo-saver-XXXXXX";
    ASSERT_NE(mkdtemp(pattern.data()), nullptr);
    root_ = pattern;
    before_ = fs::current_path();
    if (const char* home = std::getenv(homeVariable)) {
        homeBefore_ = home;
    }
    fs::create_directories(root_ / "home");
    fs::create_directories(root_ / "toons");
    setenv(homeVariable, (root_ / "home").c_str(), 1);
    fs::current_path(root_ / "toons");
    registerClass();
    forgetEarlierStages();
    setSettings();
    seam::useManualClock(1000);
    seam::answerBoxes([](const std::string&, const std::string&, UINT) { return IDOK; });
    SeedRandom(1);
    record.clear();
    TraceStart();
    TraceSink = [](const char* line) { record.emplace_back(line); };
    handles_ = seam::liveHandles();
}

void SaverTest::TearDown() {
    closeStage();
    TraceSink = nullptr;
    seam::answerBoxes(nullptr);
    EXPECT_EQ(seam::liveHandles(), handles_) << "a handle or timer was left behind";
    fs::current_path(before_);
    fs::remove_all(root_);
    if (homeBefore_) {
        setenv(homeVariable, homeBefore_->c_str(), 1);
    } else {
        unsetenv(homeVariable);
    }
}

void SaverTest::setEntries(const std::vector<std::string>& names) const {
    const fs::path toons = root_ / "toons";
    for (const auto& entry : fs::directory_iterator(toons)) {
        fs::remove_all(entry);
    }
    for (const std::string& name : names) {
        if (name.back() == '/') {
            fs::create_directory(toons / name.substr(0, name.size() - 1));
        } else {
            EXPECT_TRUE(std::ofstream(toons / name)) << name;
        }
    }
}

void SaverTest::putToon(const std::string& name, const std::string& caption,
                        const std::vector<ToonFrame>& frames) const {
    constexpr LONG fastest = 5;
    constexpr LONG background = 3;
    ToonHeader header{};
    header.version = TOON_VERSION;
    header.speed = fastest;
    header.background = background;
    CopyText(header.caption, caption.c_str(), sizeof header.caption);
    std::ofstream file(root_ / "toons" / name, std::ios::binary);
    file.write(reinterpret_cast<const char*>(&header), sizeof header);
    for (const ToonFrame& frame : frames) {
        file.write(reinterpret_cast<const char*>(&frame), sizeof frame);
    }
}

void SaverTest::openStage(int width, int height, HWND parent) {
    SettingsSave();
    const DWORD kind = parent ? WS_CHILD : WS_POPUP;
    stage = CreateWindowExA(0, stageClass, "", kind | WS_VISIBLE, 0, 0, width, height, parent,
                            nullptr, GetModuleHandleA(nullptr), nullptr);
    ASSERT_TRUE(stage);
}

void SaverTest::closeStage() {
    if (IsWindow(stage)) {
        DestroyWindow(stage);
        seam::runUntil(seam::clockNow());
    }
    stage = nullptr;
    DeleteObject(BackdropBitmap); // the next stage's start would free it
    BackdropBitmap = nullptr;
}

void SaverTest::pass(std::int64_t milliseconds) {
    seam::runUntil(seam::clockNow() + milliseconds);
}

bool SaverTest::runUntilEvent(const std::string& event) {
    constexpr std::int64_t step = 10;
    constexpr std::int64_t patience = 600000;
    for (std::int64_t waited = 0; waited < patience; waited += step) {
        record.clear();
        pass(step);
        if (!events({event}).empty()) {
            return true;
        }
    }
    return false;
}

std::vector<std::string> SaverTest::events(const std::vector<std::string>& names) {
    std::vector<std::string> found;
    for (const std::string& line : record) {
        const std::string event = line.substr(line.find(' ') + 1);
        const std::string words = event + ' ';
        if (std::any_of(names.begin(), names.end(),
                        [&](const std::string& name) { return words.rfind(name + ' ', 0) == 0; })) {
            found.push_back(event);
        }
    }
    return found;
}

std::string SaverTest::savedSetting(const std::string& key) const {
    std::ifstream file(root_ / "home/dorbo/Dorbo95.ini");
    for (std::string line; std::getline(file, line);) {
        if (line.rfind(key + '=', 0) == 0) {
            line.erase(line.find_last_not_of('\r') + 1);
            return line.substr(key.size() + 1);
        }
    }
    return {};
}

int cursorCount() {
    ShowCursor(TRUE);
    return ShowCursor(FALSE);
}

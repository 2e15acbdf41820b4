#include "tests/saver/saver_fixture.h"

#include "saver/saver_guard.h"
#include "stage/backdrop.h"
#include "stage/random_walk.h"
#include "toon/settings.h"

#include <fstream>

namespace fs = std::filesystem;

static constexpr const char* stageClass = "SaverTestClass";

void SaverTest::SetUp() {
    ground_ = std::make_unique<ReplayGround>();
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = SaverGuardProc;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = stageClass;
    RegisterClassA(&windowClass); // refused, and none the worse, from the second test on
    ForgetEarlierStages();
    WalkingStyle = Statements = Backgrounds = 1;
    PacesWalked = 100;
    GetCurrentDirectoryA(sizeof Directory, Directory);
    SeedRandom(1);
    RecordedStage::SetUp();
}

void SaverTest::TearDown() {
    closeStage();
    RecordedStage::TearDown();
    ground_.reset();
}

void SaverTest::setEntries(const std::vector<std::string>& names) const {
    for (const auto& entry : fs::directory_iterator(ground_->toons())) {
        fs::remove_all(entry);
    }
    for (const std::string& name : names) {
        if (name.back() == '/') {
            fs::create_directory(name.substr(0, name.size() - 1));
        } else {
            EXPECT_TRUE(std::ofstream(name)) << name;
        }
    }
}

void SaverTest::putToon(const std::string& name, const std::string& caption,
                        const std::vector<ToonFrame>& frames) const {
    ToonHeader header{};
    header.version = TOON_VERSION;
    header.speed = 5;
    header.background = 3;
    CopyText(header.caption, caption.c_str(), sizeof header.caption);
    std::ofstream file(ground_->toons() / name, std::ios::binary);
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
    DestroyWindow(stage);
    pass(0);
    stage = nullptr;
    DeleteObject(BackdropBitmap); // the next stage's start would free it
    BackdropBitmap = nullptr;
}

std::string SaverTest::savedSetting(const std::string& key) const {
    std::ifstream file(ground_->settingsFile());
    for (std::string line; std::getline(file, line);) {
        if (line.rfind(key + '=', 0) == 0) {
            line.erase(line.find_last_not_of('\r') + 1);
            return line.substr(key.size() + 1);
        }
    }
    return {};
}

int SaverTest::cursorCount() {
    ShowCursor(TRUE);
    return ShowCursor(FALSE);
}

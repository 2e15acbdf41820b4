// A directory of Toons and a home of its own, both gone at the end, and a stage window with the
// saver's procedure.
#pragma once

#include "cli/replay.h"
#include "saver/saver_guard.h"
#include "stage/backdrop.h"
#include "stage/random_walk.h"
#include "tests/recorded_stage.h"
#include "toon/settings.h"

#include <memory>

using Names = std::vector<std::string>;

class SaverTest : public RecordedStage {
  protected:
    void SetUp() override {
        ground_ = std::make_unique<ReplayGround>();
        ForgetEarlierStages();
        WalkingStyle = Statements = Backgrounds = 1;
        PacesWalked = 100;
        GetCurrentDirectoryA(sizeof Directory, Directory);
        SeedRandom(1);
        RecordedStage::SetUp();
    }

    void TearDown() override {
        closeStage();
        RecordedStage::TearDown();
        ground_.reset();
    }

    /// Leaves nothing but empty files of these names among the Toons; one with a slash behind it
    /// is a directory.
    void setEntries(const Names& names) const {
        for (const auto& entry : std::filesystem::directory_iterator(ground_->toons())) {
            std::filesystem::remove_all(entry);
        }
        for (const std::string& name : names) {
            if (name.back() == '/') {
                std::filesystem::create_directories(name);
            } else {
                EXPECT_TRUE(std::ofstream(name)) << name;
            }
        }
    }

    static HWND createWindow(const char* className, WNDPROC procedure, SIZE size,
                             HWND parent = nullptr) {
        WNDCLASSA windowClass{};
        windowClass.lpfnWndProc = procedure;
        windowClass.lpszClassName = className;
        RegisterClassA(&windowClass); // refused, and none the worse, from the second time on
        return CreateWindowExA(0, className, "", WS_VISIBLE | (parent ? WS_CHILD : WS_POPUP), 0, 0,
                               size.cx, size.cy, parent, nullptr, nullptr, nullptr);
    }

    /// Makes the stage window; the settings in memory are those of the user's file.
    void openStage(int width = 640, int height = 480, HWND parent = nullptr) {
        SettingsSave();
        stage = createWindow("SaverTestClass", SaverGuardProc, {width, height}, parent);
        ASSERT_TRUE(stage);
    }

    /// Ends it and takes the quit that its end posts.
    void closeStage() {
        DestroyWindow(stage);
        pass(0);
        stage = nullptr;
        DeleteObject(BackdropBitmap); // the next stage's start would free it
        BackdropBitmap = nullptr;
    }

    /// The value of a key in the user's settings file, empty if there is none.
    static std::string savedSetting(const char* key) {
        char value[300];
        GetPrivateProfileStringA("Fenky Dorbo Screen Saver", key, "", value, sizeof value,
                                 "Dorbo95.ini");
        return value;
    }

  private:
    std::unique_ptr<ReplayGround> ground_;
};

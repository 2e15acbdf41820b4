// A directory of Toons and a home of its own, both gone at the end, and a stage window with the
// saver's procedure.
#pragma once

#include "cli/replay.h"
#include "tests/recorded_stage.h"
#include "toon/toon_document.h"

#include <memory>

class SaverTest : public RecordedStage {
  protected:
    void SetUp() override;
    void TearDown() override;

    /// Leaves nothing but empty files of these names among the Toons; one with a slash behind it
    /// is a directory.
    void setEntries(const std::vector<std::string>& names) const;

    /// Makes a Toon that plays: background 3, speed 5, places not scaled.
    void putToon(const std::string& name, const std::string& caption,
                 const std::vector<ToonFrame>& frames) const;

    /// Makes the stage window; the settings in memory are those of the user's file.
    void openStage(int width = 640, int height = 480, HWND parent = nullptr);

    /// Ends it and takes the quit that its end posts.
    void closeStage();

    /// The value of a key in the user's settings file, empty if there is none.
    std::string savedSetting(const std::string& key) const;

    /// The display count of the pointer.
    static int cursorCount();

  private:
    std::unique_ptr<ReplayGround> ground_;
};

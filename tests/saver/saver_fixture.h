// A directory of Toons and a home of its own, both gone at the end; the clock moved by hand; a
// stage window with the saver's procedure; and the record of what happens on it.
#pragma once

#include "platform/harness.h"
#include "platform/user.h"
#include "toon/toon_document.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

class SaverTest : public testing::Test {
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

    /// Lets `milliseconds` pass.
    static void pass(std::int64_t milliseconds);

    /// Lets time pass until a line of the record says that this has happened anew; false if ten
    /// minutes don't bring it. The record then tells of the last 10 ms.
    static bool runUntilEvent(const std::string& event);

    /// The lines of the record that begin with one of these words, without their times.
    static std::vector<std::string> events(const std::vector<std::string>& names);

    /// A line of the user's settings file, empty if there is none of the key.
    std::string savedSetting(const std::string& key) const;

    HWND stage;

  private:
    std::filesystem::path root_;
    std::filesystem::path before_;
    std::optional<std::string> homeBefore_;
    seam::HandleCounts handles_;
};

/// The display count of the pointer.
int cursorCount();

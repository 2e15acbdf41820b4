// What the tests of a stage have in common: the clock is moved by hand, the record is kept, and
// the live handles are held at the end against those at the start.
#pragma once

#include "platform/harness.h"
#include "platform/trace.h"
#include "platform/user.h"
#include "toon/toon_document.h"

#include <gmock/gmock.h>

#include <QTimer>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <functional>
#include <string>
#include <vector>

/// Acts within a loop of the program's, as soon as `stands` says so.
inline void once(const std::function<bool()>& stands, const std::function<void()>& act) {
    QTimer::singleShot(0, [stands, act] { stands() ? act() : once(stands, act); });
}

class RecordedStage : public testing::Test {
  protected:
    void SetUp() override {
        seam::useManualClock(1000);
        record.clear();
        TraceStart();
        TraceSink = [](const char* line) { record.emplace_back(line); };
        handles_ = seam::liveHandles();
    }

    /// For the end of a derived TearDown, when the stage has gone.
    void TearDown() override {
        TraceSink = nullptr;
        EXPECT_EQ(seam::liveHandles(), handles_) << "a handle or timer was left behind";
    }

    static void pass(std::int64_t milliseconds) {
        seam::runUntil(seam::clockNow() + milliseconds);
    }

    /// Clears the record and lets time pass until it tells of this event; false if ten minutes
    /// don't bring it.
    static bool runUntilEvent(const std::string& event) {
        constexpr std::int64_t step = 10;
        constexpr std::int64_t patience = 600000;
        record.clear();
        for (std::int64_t waited = 0; waited < patience && count(event) == 0; waited += step) {
            pass(step);
        }
        return count(event) != 0;
    }

    /// The lines of the record that begin with one of these words, without their times.
    static std::vector<std::string> events(const std::vector<std::string>& names) {
        std::vector<std::string> found;
        for (const std::string& line : record) {
            const std::string event = line.substr(line.find(' ') + 1);
            if (std::any_of(names.begin(), names.end(), [&](const std::string& name) {
                    return (event + ' ').rfind(name + ' ', 0) == 0;
                })) {
                found.push_back(event);
            }
        }
        return found;
    }

    static std::size_t count(const std::string& event) {
        return events({event}).size();
    }

    /// Makes a Toon that plays: background 3, speed 5, places scaled by the size if there is one.
    static void writeToon(const std::filesystem::path& path, const std::vector<ToonFrame>& frames,
                          const std::string& caption = "", DWORD windowSize = 0) {
        ToonHeader header{"", TOON_VERSION, "", windowSize, 0, 5, 3};
        CopyText(header.caption, caption.c_str(), sizeof header.caption);
        std::ofstream file(path, std::ios::binary);
        file.write(reinterpret_cast<const char*>(&header), sizeof header);
        file.write(reinterpret_cast<const char*>(frames.data()),
                   static_cast<std::streamsize>(frames.size() * sizeof(ToonFrame)));
    }

    /// The stage's picture.
    std::vector<DWORD> pixels() const {
        return seam::windowPicture(stage).pixels;
    }

    static inline std::vector<std::string> record;

    HWND stage;

  private:
    seam::HandleCounts handles_;
};

// A stage in a window of the tests' own, on a clock that is moved by hand, with a host round it
// that notes what the stage asks of it.
#pragma once

#include "platform/harness.h"
#include "stage/stage.h"
#include "toon/toon_document.h"

#include <gmock/gmock.h>

#include <functional>
#include <string>
#include <vector>

class StageTest : public testing::Test {
  protected:
    void SetUp() override;
    void TearDown() override;

    /// Makes the stage window anew in another size, and loads art and backdrop.
    void openStage(int width, int height);
    void closeStage();

    /// Puts a Toon of these frames in memory, recorded on a stage of the present size, speed 3.
    static void openToon(const std::vector<ToonFrame>& frames);
    static ToonFrame frame(LONG x, LONG y, LONG pose, LONG pause, LONG wink, const char* text);

    /// Lets the clock come to `milliseconds` since the stage window was made.
    void runTo(std::int64_t milliseconds) const;

    /// Brings a show to the moment of this event and clears the record. False if it never comes.
    bool runUntilEvent(const std::string& event) const;

    /// The lines of the record that begin with one of these events, without their times.
    static std::vector<std::string> events(const std::vector<std::string>& names);
    static int count(const std::string& event);

    /// The stage's picture within a rectangle, for comparisons.
    std::vector<DWORD> pixels(RECT area) const;

    HWND stage;
    std::int64_t opened = 0;
};

// What the window and the host of the test note. Cleared at the start of each test.
extern std::vector<std::string> Record;    // the trace
extern std::vector<std::string> HostCalls; // e.g. "SetPlayButton 2"
extern std::function<void()> OnShowDone;   // what the window does on TM_SHOWDONE
extern DWORD RepaintFlag;

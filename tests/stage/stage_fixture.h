// A stage in a window of the tests' own, with a host round it that notes what the stage asks of it.
#pragma once

#include "stage/stage.h"
#include "tests/recorded_stage.h"
#include "toon/toon_document.h"

class StageTest : public RecordedStage {
  protected:
    void SetUp() override;
    void TearDown() override;

    /// Makes the stage window, anew in another size if need be, and loads art and backdrop.
    void openStage(int width = 1024, int height = 768);
    void closeStage();

    /// Puts a Toon of these frames in memory, recorded on a stage of the present size, speed 3.
    static void openToon(const std::vector<ToonFrame>& frames);

    /// Puts him at a place without a walk.
    static void stand(LONG x, LONG y);

    void repaint() const;
};

extern std::vector<std::string> HostCalls; // of this test, e.g. "SetPlayButton 2"
extern DWORD RepaintFlag;                  // what the window hands to PaintStage

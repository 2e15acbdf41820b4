// A stage of the saver's that keeps its size, and on which nothing begins by itself.
#pragma once

#include "saver/show_cycle.h"
#include "stage/character.h"
#include "stage/stage.h"
#include "tests/saver/saver_fixture.h"

class StageTest : public SaverTest {
  protected:
    void SetUp() override {
        SaverTest::SetUp();
        openStage();
    }

    static LRESULT stageProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
        return message == WM_SIZE || message == TM_SHOWDONE
                   ? 0
                   : SaverGuardProc(window, message, wParam, lParam);
    }

    /// Makes the stage window, anew in another size if need be; its titles have been shown.
    void openStage(int width = 1024, int height = 768) {
        closeStage();
        StageRepaintFlag = 1;
        stage = createWindow("StageTestClass", stageProc, {width, height});
        KillTimer(stage, TIMER_SHOWSTART);
        OpeningDone = TitleShown = 1;
        repaint();
        record.clear();
    }

    /// Puts a Toon of these frames in memory, recorded on a stage of the present size.
    static void openToon(const std::vector<ToonFrame>& frames) {
        FrameCount = static_cast<LONG>(frames.size());
        ASSERT_EQ(FrameStoreAlloc(FrameCount), 1);
        for (LONG index = 0; index < FrameCount; ++index) {
            FramePut(index, &frames[static_cast<std::size_t>(index)]);
        }
        ToonDocHeader.windowSize = StageSize;
    }

    /// Puts him at a place without a walk.
    static void stand(LONG x, LONG y) {
        CharacterSprite.x = CharacterSprite.drawX = x;
        CharacterSprite.y = CharacterSprite.drawY = y;
    }

    void repaint() const {
        InvalidateRect(stage, nullptr, FALSE);
        UpdateWindow(stage);
    }
};

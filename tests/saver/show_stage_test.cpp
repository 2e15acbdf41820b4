// The stage of a show: what it takes and gives back, and in which windows it stands.
#include "saver/show_cycle.h"

#include "stage/character.h"
#include "stage/face.h"
#include "stage/stage.h"
#include "stage/walk.h"
#include "tests/saver/saver_fixture.h"

namespace {

class ShowStage : public SaverTest {
  protected:
    /// Whether it shows backdrop, caption and figure as they belong there, and nothing else.
    bool isClean() const {
        const std::vector<DWORD> shown = pixels();
        const HDC dc = GetDC(stage);
        BlitBackdrop(dc, stage, BackdropBitmap);
        DrawTitles(dc, stage);
        SpriteStampOnce(dc, CharacterSprite.frameBitmap, CharacterSprite.drawX,
                        CharacterSprite.drawY);
        ReleaseDC(stage, dc);
        return shown == pixels();
    }

    /// The display count of the pointer.
    static int cursorCount() {
        ShowCursor(TRUE);
        return ShowCursor(FALSE);
    }
};

} // namespace

TEST_F(ShowStage, TakesWhatAShowNeedsAndGivesItBack) {
    constexpr DWORD sizeBefore = MAKELONG(11, 22);
    const int cursorBefore = cursorCount();
    writeToon("a.zkt", {{300, 200, 0, 5, 0, "Hello you there, all of you", 0}});
    for (const DWORD mode : {PREVIEW_NONE, PREVIEW_WHOLE}) {
        PreviewMode = mode;
        StageSize = sizeBefore;
        OpeningDone = TitleShown = 1;
        openStage(640, 480);
        EXPECT_EQ(StageSize, MAKELONG(640, 480));
        EXPECT_EQ(OpeningDone + TitleShown, 0U);
        EXPECT_STREQ(StageTitle, "Fenky Dorbo Screen Saver");
        EXPECT_EQ(cursorCount(), cursorBefore - 1) << "no arrow over a host's pointer either";
        ASSERT_TRUE(runUntilEvent("bubble_show"));

        closeStage();
        EXPECT_EQ(StageSize, sizeBefore);
        EXPECT_EQ(SaverActive + OpeningDone + TitleShown + CharacterArtLoaded, 0U);
        EXPECT_EQ(cursorCount(), cursorBefore);
        EXPECT_FALSE(FrameStore || ExpressionSheet || TitleFont || BylineFont);
        EXPECT_GT(PacesWalked, 100U);
        EXPECT_EQ(savedSetting("Paces Walked"), std::to_string(PacesWalked));
    }
}

TEST_F(ShowStage, ThePreviewWalksOnceAndNeverLoadsWhatItChose) {
    const HWND parent = createWindow("SaverTestParent", DefWindowProcA, {300, 200});
    const int cursorBefore = cursorCount();
    PreviewMode = PREVIEW_WALK;
    setEntries({"bad.zkt"});
    PacesWalked = 0;
    openStage(300, 200, parent);
    EXPECT_STREQ(NextToonFile, "bad.zkt");
    EXPECT_EQ(cursorCount(), cursorBefore);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_THAT(events({"random_walk", "timer_set timer=PAUSE", "show_done", "random_walk_refused",
                        "load"}),
                testing::ElementsAre("random_walk target=[10,0] pose=6 wink=1 statement=0",
                                     "timer_set timer=PAUSE id=2 ms=3000", "show_done",
                                     "random_walk_refused", "show_done", "random_walk_refused"));
    EXPECT_EQ(seam::liveHandles().timers, 0U);
    closeStage();
    EXPECT_EQ(cursorCount(), cursorBefore);
    DestroyWindow(parent);
}

TEST_F(ShowStage, AStageOfAnotherSizeShowsNoTraceOfTheOldOne) {
    writeToon(
        "a.zkt",
        {{512, 80, 0, 3, 0, "Up here!", 0}, {700, 66, 0, 1, 0, "", 0}, {100, 60, 0, 1, 0, "", 0}},
        "Once round the whole garden");
    for (const SIZE& size : {SIZE{1200, 900}, SIZE{500, 400}, SIZE{1024, 768}}) {
        SCOPED_TRACE(size.cx);
        openStage(1024, 768);
        ASSERT_TRUE(runUntilEvent("bubble_show"));
        MoveWindow(stage, 0, 0, size.cx, size.cy, FALSE);
        ASSERT_TRUE(runUntilEvent("bubble_hide"));
        ASSERT_TRUE(runUntilEvent("draw"));
        EXPECT_TRUE(isClean()) << "his bubble came off";
        MoveWindow(stage, 0, 0, 1024, 768, FALSE);
        ASSERT_TRUE(runUntilEvent("frame index=2"));
        do { // until he walks through the caption
            ASSERT_TRUE(runUntilEvent("draw"));
        } while (CharacterSprite.drawX > 460);
        const LONG step = WalkStepIndex;
        MoveWindow(stage, 30, 20, size.cx, size.cy, FALSE);
        EXPECT_EQ(count("rebuild_backdrop"), size.cx == 1024 ? 0U : 1U);
        pass(0);
        for (int i = 0; i < 10; ++i) {
            EXPECT_TRUE(isClean()) << "step " << i;
            ASSERT_TRUE(runUntilEvent("draw"));
        }
        EXPECT_EQ(WalkStepIndex, step + 10) << "the walk goes on";
        closeStage();
    }
}

#include "saver/show_cycle.h"

#include "stage/character.h"
#include "stage/face.h"
#include "stage/stage.h"
#include "stage/walk.h"
#include "tests/saver/saver_fixture.h"

#include <malloc.h>
#include <utility>

using testing::ElementsAre;

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
};

} // namespace

TEST_F(ShowStage, TakesWhatAShowNeedsAndGivesItBack) {
    constexpr DWORD sizeBefore = MAKELONG(11, 22);
    StageSize = sizeBefore;
    OpeningDone = TitleShown = 1;
    BackgroundIndex = 7;
    const int cursorBefore = cursorCount();
    writeToon("a.zkt", {{300, 200, 0, 5, 0, "Hello you there, all of you", 0}});

    openStage(640, 480);
    EXPECT_EQ(StageSize, MAKELONG(640, 480));
    EXPECT_EQ(SaverActive, 1U);
    EXPECT_EQ(OpeningDone + TitleShown, 0U);
    EXPECT_EQ(BackgroundIndex, 0);
    EXPECT_STREQ(StageTitle, "Fenky Dorbo Screen Saver");
    EXPECT_EQ(cursorCount(), cursorBefore - 1);
    ASSERT_TRUE(runUntilEvent("bubble_show"));

    closeStage();
    EXPECT_EQ(StageSize, sizeBefore);
    EXPECT_EQ(SaverActive + OpeningDone + TitleShown + CharacterArtLoaded, 0U);
    EXPECT_EQ(cursorCount(), cursorBefore);
    EXPECT_FALSE(FrameStore || ExpressionSheet || TitleFont || BylineFont);
    EXPECT_GT(PacesWalked, 100U);
    EXPECT_EQ(savedSetting("Paces Walked"), std::to_string(PacesWalked));
}

TEST_F(ShowStage, ThePreviewWalksOnceAndNeverLoadsWhatItChose) {
    const std::tuple<Names, const char*, const char*> cases[] = {{{"bad.zkt"}, "bad.zkt", "1"},
                                                                 {{}, "", "0"}};
    const HWND parent = createWindow("SaverTestParent", DefWindowProcA, {300, 200});
    const int cursorBefore = cursorCount();
    PreviewMode = PREVIEW_WALK;
    for (const auto& [entries, file, styleSaved] : cases) {
        setEntries(entries);
        WalkingStyle = 1;
        Backgrounds = 0;
        PacesWalked = 0;
        openStage(300, 200, parent);
        EXPECT_STREQ(NextToonFile, file);
        ASSERT_TRUE(runUntilEvent("show_done"));
        EXPECT_THAT(events({"random_walk", "show_done", "random_walk_refused", "load"}),
                    ElementsAre("random_walk target=[10,0] pose=6 wink=1 statement=0", "show_done",
                                "random_walk_refused", "show_done", "random_walk_refused"));
        EXPECT_THAT(events({"timer_set timer=PAUSE"}),
                    ElementsAre("timer_set timer=PAUSE id=2 ms=3000"));
        EXPECT_EQ(seam::liveHandles().timers, 0U);
        closeStage();
        EXPECT_EQ(cursorCount(), cursorBefore);
        EXPECT_EQ(savedSetting("Walking Style"), styleSaved);
    }
    DestroyWindow(parent);
}

TEST_F(ShowStage, InAWindowOfAHostTheWholeShowGoesOnWhateverTheToons) {
    const int cursorBefore = cursorCount();
    PreviewMode = PREVIEW_WHOLE;
    writeToon("a.zkt", {{300, 200, 0, 5, 0, "Hello you there, all of you", 1}}, "Whole");
    openStage(565, 317);
    EXPECT_EQ(cursorCount(), cursorBefore - 1) << "no arrow over the host's pointer";
    EXPECT_TRUE(runUntilEvent("bubble_show"));
    EXPECT_TRUE(runUntilEvent("show_done"));
    EXPECT_TRUE(runUntilEvent("bubble_show")) << "and once more";
    closeStage();
    EXPECT_EQ(cursorCount(), cursorBefore);

    setEntries({"empty.zkt"});
    WalkingStyle = 1;
    seam::answerBoxes([](auto&&...) { return IDOK; });
    openStage(565, 317);
    for (int show = 0; show < 3; ++show) {
        EXPECT_TRUE(runUntilEvent("show_done")) << "he walks about instead";
    }
    seam::answerBoxes(nullptr);
}

TEST_F(ShowStage, AStageOfAnotherSizeShowsNoTraceOfTheOldOne) {
    const SIZE sizes[] = {{1024, 768}, {1200, 900}, {500, 400}};
    writeToon("a.zkt", {{700, 66, 0, 1, 0, "", 0}, {100, 60, 0, 1, 0, "", 0}},
              "Once round the whole garden");
    for (const SIZE& size : sizes) {
        SCOPED_TRACE(size.cx);
        openStage(1024, 768);
        ASSERT_TRUE(runUntilEvent("frame index=1"));
        do { // until he walks through the caption
            ASSERT_TRUE(runUntilEvent("draw"));
        } while (CharacterSprite.drawX > 460);
        ASSERT_TRUE(isClean());
        const LONG step = WalkStepIndex;
        MoveWindow(stage, 30, 20, size.cx, size.cy, FALSE);
        EXPECT_EQ(count("rebuild_backdrop"), size.cx == 1024 ? 0U : 1U);
        pass(0);
        EXPECT_TRUE(isClean());
        for (int i = 0; i < 10; ++i) {
            ASSERT_TRUE(runUntilEvent("draw"));
            EXPECT_TRUE(isClean()) << "step " << i;
        }
        EXPECT_EQ(WalkStepIndex, step + 10) << "the walk goes on";
        closeStage();
    }
}

TEST_F(ShowStage, AnHourOfShowsLeavesNothingBehind) {
    constexpr std::int64_t hour = 3600000;
    constexpr std::size_t slack = 16384; // bytes, for lists that find their size
    writeToon("a.zkt", {{300, 200, 0, 5, 2, "Hello you there, all of you", 3}});
    writeToon("b.zkt", {{90, 20, 0, 2, 0, "", 0}, {400, 300, 0, 7, 2, "Well!", 2}});
    for (const LONG style : {0, 1}) {
        WalkingStyle = style;
        openStage();
        ASSERT_TRUE(runUntilEvent("choice"));
        ASSERT_TRUE(runUntilEvent("choice"));
        const std::size_t heap = mallinfo2().uordblks;
        const seam::HandleCounts handles = seam::liveHandles();
        const auto sink = std::exchange(TraceSink, nullptr); // the record itself grows
        pass(hour);
        TraceSink = sink;
        ASSERT_TRUE(runUntilEvent("choice"));
        EXPECT_LE(mallinfo2().uordblks, heap + slack) << style;
        EXPECT_EQ(seam::liveHandles(), handles) << style;
        closeStage();
    }
}

TEST_F(ShowStage, TheBubbleComesOffAStageOfAnotherSize) {
    writeToon("a.zkt", {{512, 80, 0, 3, 0, "Up here!", 0}, {200, 400, 0, 3, 0, "", 0}},
              "A caption that stands elsewhere on another stage");
    openStage(1024, 768);
    ASSERT_TRUE(runUntilEvent("bubble_show"));
    MoveWindow(stage, 0, 0, 1200, 900, FALSE);
    ASSERT_TRUE(runUntilEvent("bubble_hide"));
    ASSERT_TRUE(runUntilEvent("draw"));
    EXPECT_TRUE(isClean());
}

#include "stage/player.h"

#include "stage/bubble.h"
#include "stage/character.h"
#include "stage/face.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

#include <limits>

using testing::ElementsAre;
using testing::IsEmpty;

namespace {

class Player : public StageTest {};

const RECT wholeStage = {0, 0, 1024, 768};

} // namespace

TEST_F(Player, ActsAToonOutFromEntranceToWalkOff) {
    openToon({frame(500, 400, 3, 2, 1, "Hello you there"), frame(700, 400, 1, 1, 0, "")});
    PlayNextFrame(stage);
    ASSERT_TRUE(runUntilEvent("walk_done"));
    EXPECT_EQ(AwaitingArrival, 0U);
    EXPECT_EQ(PendingPause, 2);
    EXPECT_THAT(events({"face", "timer_set"}),
                ElementsAre("face expr=1 src=[0,33] dst=[" +
                                std::to_string(CharacterSprite.drawX + 59) + "," +
                                std::to_string(CharacterSprite.drawY + 14) + "]",
                            "timer_set timer=ARRIVAL id=1 ms=500"));
    ASSERT_TRUE(runUntilEvent("bubble_show"));
    EXPECT_THAT(events({"tick", "timer_set", "timer_kill", "talk_start"}),
                ElementsAre("tick timer=ARRIVAL", "timer_set timer=TALK id=10 ms=250",
                            "talk_start total=3", "timer_kill timer=ARRIVAL id=1 was_set=1",
                            "timer_set timer=PAUSE id=2 ms=2000"));
    ASSERT_TRUE(runUntilEvent("bubble_hide"));
    EXPECT_THAT(events({"frame", "bubble_hide", "talk_stop"}).front(),
                testing::StartsWith("talk_stop")); // by its own end, before the pause's
    EXPECT_EQ(NextFrameIndex, 2);
    EXPECT_EQ(CurrentFrameIndex, 1);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_THAT(events({"walk_off", "bubble_show", "face", "talk_start"}),
                ElementsAre("walk_off target=[1074,335]"));
    EXPECT_EQ(seam::liveHandles().timers, 0U);
    EXPECT_EQ(NextFrameIndex, 0);
    EXPECT_THAT(HostCalls, ElementsAre("DisableButtons", "SetPlayButton 2", "SetPlayButton 2",
                                       "RestoreButtons", "SetPlayButton 0"));
}

TEST_F(Player, TakesTheBubbleOffAfterTheNextWalkIsPlannedAndBeforeItMoves) {
    openToon({frame(500, 400, 3, 1, 0, "A longer text than a second holds"),
              frame(700, 400, 1, 1, 0, "")});
    PlayNextFrame(stage);
    ASSERT_TRUE(runUntilEvent("bubble_show"));
    ASSERT_TRUE(runUntilEvent("draw"));
    const std::vector<std::string> seen = events({"frame", "bubble_hide", "talk_stop", "draw"});
    ASSERT_EQ(seen.size(), 4U);
    EXPECT_EQ(seen[0], "frame index=1 target=[635,335]");
    EXPECT_THAT(seen[1], testing::EndsWith("shown=1"));
    EXPECT_EQ(seen[2], "talk_stop");
}

TEST_F(Player, EntersFromTheSideNearerToTheFrameAsRecorded) {
    const struct {
        LONG x;
        LONG enterX;
    } cases[] = {{511, -150}, {512, 1074}, {2000, 1074}, {-5, -150}};

    for (const auto& one : cases) {
        openToon({frame(one.x, 333, 0, 1, 0, "")});
        EnterShow(stage);
        EXPECT_EQ(CharacterX, one.enterX) << one.x;
        EXPECT_EQ(CharacterSprite.drawX, one.enterX);
        EXPECT_EQ(CharacterSprite.y, 333);
    }
    EXPECT_EQ(events({"enter"}).front(), "enter draw=[-150,333] side=left");
}

TEST_F(Player, LeavesByTheSideNearerToHisCorner) {
    const LONG cases[][2] = {{520, -150}, {576, -150}, {577, 1074}, {900, 1074}};
    for (const auto& one : cases) {
        openToon({frame(one[0], 333, 0, 1, 0, "")});
        EnterShow(stage);
        WalkToNextFrame(stage);
        StopWalkTimer(stage);
        Record.clear();
        WalkOffStage(stage);
        EXPECT_EQ(events({"walk_off"}).front(),
                  "walk_off target=[" + std::to_string(one[1]) + ",268]");
        StopWalkTimer(stage);
    }
}

TEST_F(Player, ScalesTheCornerNotTheCentre) {
    openToon({frame(1000, 600, 0, 1, 0, "")});
    ToonDocHeader.windowSize = MAKELONG(2048, 384);
    EnterShow(stage);
    ASSERT_EQ(WalkToNextFrame(stage), 1);
    EXPECT_EQ(events({"frame"}).front(), "frame index=0 target=[467,1070]");
    EXPECT_EQ(CharacterX, 467);
    EXPECT_EQ(WalkToNextFrame(stage), 0) << "there is no second frame";
    EXPECT_EQ(NextFrameIndex, 1);
}

TEST_F(Player, StandsAtAFrameWithoutAPause) {
    for (const LONG pause : {0, -3}) {
        openToon({frame(500, 400, 0, pause, 1, "Never said")});
        PlayNextFrame(stage);
        ASSERT_TRUE(runUntilEvent("walk_done"));
        EXPECT_EQ(seam::liveHandles().timers, 0U) << pause;
        EXPECT_THAT(events({"face", "talk_start", "bubble_show"}), IsEmpty()) << pause;
        ResetShow(stage);
    }
}

TEST_F(Player, WaitsOutThePauseOfASilentFrame) {
    openToon({frame(500, 400, 0, 3, 0, "")});
    PlayNextFrame(stage);
    ASSERT_TRUE(runUntilEvent("walk_done"));
    const std::int64_t arrived = seam::clockNow();
    ASSERT_TRUE(runUntilEvent("walk_off"));
    EXPECT_NEAR(static_cast<double>(seam::clockNow() - arrived), 3500, 10);
    EXPECT_EQ(BubbleHidden, 0U) << "an arrival display without a bubble";
    EXPECT_THAT(events({"face", "talk_start", "bubble_show", "bubble_hide"}), IsEmpty());
}

TEST_F(Player, HoldsAPauseToWhatATimerTakes) {
    ArrivalPause(stage, "", std::numeric_limits<LONG>::max());
    ArrivalPause(stage, nullptr, -1);
    EXPECT_EQ(events({"timer_set"}).back(), "timer_set timer=PAUSE id=2 ms=2147483647");
}

TEST_F(Player, AnArrivalCancelledInItsHalfSecondStaysCancelled) {
    PlayFrame = frame(0, 0, 0, 4, 1, "Not to be said");
    ArrivalPause(stage, PlayFrame.text, 4);
    runTo(300);
    CancelArrival(stage);
    EXPECT_EQ(PendingPause, 0);
    Record.clear();
    runTo(10000);
    EXPECT_THAT(Record, IsEmpty());
}

TEST_F(Player, ResetBringsEveryStateToRest) {
    const std::vector<DWORD> empty = pixels(wholeStage);
    for (const char* moment : {"draw", "walk_done", "bubble_show", "tick timer=TALK", "walk_off"}) {
        openToon({frame(500, 400, 3, 2, 1, "Hello you there, all of you")});
        PlayNextFrame(stage);
        ASSERT_TRUE(runUntilEvent(moment)) << moment;
        ResetShow(stage);
        EXPECT_EQ(seam::liveHandles().timers, 0U) << moment;
        EXPECT_EQ(WalkTimerRunning + ShowStarted + AwaitingArrival + Talking, 0U) << moment;
        EXPECT_STREQ(PendingText, "") << moment;
        EXPECT_EQ(PendingPause, 0) << moment;
        EXPECT_FALSE(ShowUnderWay()) << moment;
        EXPECT_EQ(CharacterSprite.drawX, -150) << moment;
        EXPECT_EQ(pixels(wholeStage), empty) << moment;
    }
}

TEST_F(Player, ResetWithoutArtDoesNothing) {
    openToon({frame(900, 400, 3, 2, 1, "")});
    NextFrameIndex = 1;
    ReleaseStageArt();
    ResetShow(stage);
    EXPECT_EQ(NextFrameIndex, 1);
}

TEST_F(Player, TellsHowFarTheShowHasCome) {
    const struct {
        LONG range;
        LONG next;
        LONG frames;
        LONG progress;
    } cases[] = {{100, 0, 3, 0},
                 {100, 1, 3, 33},
                 {100, 3, 3, 100},
                 {100, 1, 1, 100},
                 {100, 2, 0, 200},
                 {-10, 1, 3, -3},
                 {2147483647, 7, 7, 2147483647}};

    for (const auto& one : cases) {
        NextFrameIndex = one.next;
        FrameCount = one.frames;
        EXPECT_EQ(PlayProgress(one.range), one.progress) << one.range << ' ' << one.next;
    }
    FrameCount = 0;
}

TEST_F(Player, BeginsCleanOnEveryStage) {
    for (const char* moment : {"draw", "walk_done", "tick timer=TALK"}) {
        openToon({frame(500, 400, 3, 2, 1, "Hello you there")});
        PlayNextFrame(stage);
        ASSERT_TRUE(runUntilEvent(moment)) << moment;
        const LONG mouth = LastMouthShape;
        RandomWalkActive = WalkingOut = 1;
        openStage(1024, 768);
        BubbleHidden = 0;
        StageBegin();
        EXPECT_EQ(WalkTimerRunning + AwaitingArrival + ShowStarted + Talking, 0U) << moment;
        EXPECT_EQ(RandomWalkActive + WalkingOut, 0U) << moment;
        EXPECT_EQ(NextFrameIndex + PendingPause + WalkStepIndex, 0) << moment;
        EXPECT_STREQ(PendingText, "") << moment;
        EXPECT_EQ(BubbleHidden + PlayIdle, 2U) << moment;
        EXPECT_EQ(LastMouthShape, mouth) << moment;
    }
}

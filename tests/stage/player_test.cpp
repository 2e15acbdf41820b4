// The player of frames and what a click on the editor's stage does.
#include "stage/player.h"

#include "stage/bubble.h"
#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/face.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

#include <limits>

using testing::ElementsAre;
using testing::IsEmpty;
using testing::StartsWith;

namespace {

class Player : public StageTest {};

class Click : public StageTest {
  protected:
    void click(LONG x, LONG y) const {
        StageClick(stage, static_cast<LPARAM>(MAKELONG(x, y)));
    }
};

} // namespace

TEST_F(Player, TellsTheHostOfAShowsCourse) {
    openToon({{500, 400, 3, 2, 1, "Hello you there", 0}, {700, 400, 1, 1, 0, "", 0}});
    PlayNextFrame(stage);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_THAT(HostCalls, ElementsAre("DisableButtons", "SetPlayButton 2", "SetPlayButton 2",
                                       "RestoreButtons", "SetPlayButton 0"));
    EXPECT_EQ(seam::liveHandles().timers, 0U);
    EXPECT_EQ(NextFrameIndex, 0);
    EXPECT_EQ(CurrentFrameIndex, 1);
}

TEST_F(Player, EntersByTheSideOfTheRecordedPlaceAndLeavesByThatOfHisCorner) {
    const LONG cases[][3] = {{-5, -150, -150},
                             {511, -150, -150},
                             {512, 1074, -150},
                             {576, 1074, -150},
                             {577, 1074, 1074}};
    for (const auto& [x, enterX, leaveX] : cases) {
        SCOPED_TRACE(x);
        openToon({{x, 333, 0, 1, 0, "", 0}});
        EnterShow(stage);
        EXPECT_EQ(CharacterSprite.drawX, enterX);
        WalkToNextFrame(stage);
        StopWalkTimer(stage);
        record.clear();
        WalkOffStage(stage);
        StopWalkTimer(stage);
        EXPECT_THAT(events({"walk_off"}),
                    ElementsAre("walk_off target=[" + std::to_string(leaveX) + ",268]"));
    }
}

TEST_F(Player, HoldsAPauseToWhatATimerTakes) {
    ArrivalPause(stage, "", std::numeric_limits<LONG>::max());
    ArrivalPause(stage, nullptr, -1);
    EXPECT_EQ(events({"timer_set"}).back(), "timer_set timer=PAUSE id=2 ms=2147483647");
}

TEST_F(Player, ResetBringsEveryStateToRest) {
    const std::vector<DWORD> empty = pixels();
    for (const char* moment : {"draw", "walk_done", "bubble_show", "tick timer=TALK", "walk_off"}) {
        SCOPED_TRACE(moment);
        openToon({{500, 400, 3, 2, 1, "Hello you there, all of you", 0}});
        PlayNextFrame(stage);
        ASSERT_TRUE(runUntilEvent(moment));
        ResetShow(stage);
        EXPECT_EQ(seam::liveHandles().timers, 0U);
        EXPECT_EQ(WalkTimerRunning + ShowStarted + AwaitingArrival + Talking, 0U);
        EXPECT_STREQ(PendingText, "");
        EXPECT_EQ(PendingPause + NextFrameIndex, 0);
        EXPECT_EQ(CharacterSprite.drawX, -150);
        EXPECT_EQ(pixels(), empty);
        record.clear();
        pass(10000);
        EXPECT_THAT(record, IsEmpty());
    }
    ReleaseStageArt();
    NextFrameIndex = 1;
    ResetShow(stage);
    EXPECT_EQ(NextFrameIndex, 1) << "without art nothing happens";
}

TEST_F(Player, TellsHowFarTheShowHasCome) {
    NextFrameIndex = 2;
    FrameCount = 3;
    EXPECT_EQ(PlayProgress(100), 66);
    EXPECT_EQ(PlayProgress(2147483647), 1431655764);
    FrameCount = 0;
    EXPECT_EQ(PlayProgress(100), 200);
}

TEST_F(Player, AStageBeginsAtRestWhateverTheLastOneLeft) {
    openToon({{500, 400, 3, 2, 1, "Hello you there", 0}});
    PlayNextFrame(stage);
    ASSERT_TRUE(runUntilEvent("tick timer=TALK"));
    const LONG mouth = LastMouthShape;
    WalkTimerRunning = AwaitingArrival = RandomWalkActive = WalkingOut = 1;
    WalkStepIndex = PendingPause = 3;
    openStage();
    BubbleHidden = 0;
    StageBegin();
    EXPECT_EQ(WalkTimerRunning + AwaitingArrival + ShowStarted + Talking, 0U);
    EXPECT_EQ(RandomWalkActive + WalkingOut, 0U);
    EXPECT_EQ(NextFrameIndex + PendingPause + WalkStepIndex, 0);
    EXPECT_STREQ(PendingText, "");
    EXPECT_EQ(BubbleHidden + PlayIdle, 2U);
    EXPECT_EQ(LastMouthShape, mouth);
}

TEST_F(Click, BringsHisMiddleToThePointTakenAsSigned) {
    const struct {
        LONG x;
        LONG y;
        const char* walk;
    } cases[] = {{420, 300, "walk from=[100,100] to=[355,235] "},
                 {-20, -1, "walk from=[100,100] to=[-85,-66] "}};

    for (const auto& one : cases) {
        stand(100, 100);
        record.clear();
        click(one.x, one.y);
        EXPECT_THAT(events({"walk"}), ElementsAre(StartsWith(one.walk)));
        ASSERT_TRUE(runUntilEvent("show_done"));
    }
}

TEST_F(Click, OnHimDoesNothing) {
    stand(100, 100);
    for (const HWND editor : {HWND{}, stage}) {
        EditorDialog = editor;
        click(100, 100);
        click(229, 229);
    }
    EXPECT_THAT(events({"walk"}), IsEmpty());
    EXPECT_THAT(HostCalls, IsEmpty());
    click(230, 229);
    EXPECT_THAT(HostCalls, ElementsAre("FrameFromClick 230 229"));
}

TEST_F(Click, DoesNothingDuringAShowUnlessAFrameIsEdited) {
    const struct {
        LONG next;
        DWORD started;
        DWORD randomWalk;
        std::size_t walks;
    } cases[] = {{0, 0, 0, 1}, {1, 1, 0, 0}, {0, 1, 0, 0}, {1, 0, 0, 0}, {0, 0, 1, 0}};

    stand(100, 100);
    for (const auto& one : cases) {
        SCOPED_TRACE(testing::PrintToString(one.next) + testing::PrintToString(one.started));
        NextFrameIndex = one.next;
        ShowStarted = one.started;
        RandomWalkActive = one.randomWalk;
        EditorDialog = nullptr;
        record.clear();
        click(600, 600);
        EXPECT_EQ(events({"walk", "walk_refused"}).size(), one.walks);
        StopWalkTimer(stage);
        EditorDialog = stage;
        HostCalls.clear();
        click(600, 600);
        EXPECT_THAT(HostCalls, ElementsAre("FrameFromClick 600 600"));
    }
}

// The player of frames and what a click on the editor's stage does, beyond the recorded shows.
#include "stage/player.h"

#include "stage/bubble.h"
#include "stage/face.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

#include <limits>

using testing::ElementsAre;
using testing::StartsWith;

namespace {

class Player : public StageTest {};

} // namespace

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
    }
    ReleaseStageArt();
    NextFrameIndex = 1;
    ResetShow(stage);
    EXPECT_EQ(NextFrameIndex, 1) << "without art nothing happens";
}

TEST_F(Player, ThePointerTellsThatHeIsBusyButNotInTheSaver) {
    for (const DWORD saver : {1U, 0U}) {
        SaverActive = saver;
        SetBusyCursor(stage, TRUE);
        const DWORD cursor = SetClassLongA(stage, GCL_HCURSOR, 0);
        EXPECT_EQ(cursor, saver == 1 ? 0U : IDC_WAIT.number) << saver;
    }
    SaverActive = 1;
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
    WalkTimerRunning = AwaitingArrival = ShowStarted = Talking = 1;
    RandomWalkActive = WalkingOut = 1;
    NextFrameIndex = PendingPause = WalkStepIndex = 3;
    CopyText(PendingText, "Hello", sizeof PendingText);
    BubbleHidden = PlayIdle = 0;
    StageBegin();
    EXPECT_EQ(WalkTimerRunning + AwaitingArrival + ShowStarted + Talking, 0U);
    EXPECT_EQ(RandomWalkActive + WalkingOut, 0U);
    EXPECT_EQ(NextFrameIndex + PendingPause + WalkStepIndex, 0);
    EXPECT_STREQ(PendingText, "");
    EXPECT_EQ(BubbleHidden + PlayIdle, 2U);
}

TEST_F(Player, AClickBringsHisMiddleToThePointTakenAsSignedUnlessItIsOnHim) {
    const std::tuple<LONG, LONG, const char*> cases[] = {
        {420, 300, "walk from=[100,100] to=[355,235] "},
        {-20, -1, "walk from=[100,100] to=[-85,-66] "}};
    for (const auto& [x, y, walk] : cases) {
        stand(100, 100);
        record.clear();
        StageClick(stage, static_cast<LPARAM>(MAKELONG(100, 229)));
        StageClick(stage, static_cast<LPARAM>(MAKELONG(x, y)));
        EXPECT_THAT(events({"walk", "walk_refused"}), ElementsAre(StartsWith(walk)));
        ASSERT_TRUE(runUntilEvent("show_done"));
    }
}

TEST_F(Player, AClickDoesNothingDuringAShow) {
    const std::tuple<LONG, DWORD, DWORD, std::size_t> cases[] = {
        {0, 0, 0, 1}, {0, 1, 0, 0}, {1, 0, 0, 0}, {0, 0, 1, 0}};
    for (const auto& [next, started, randomWalk, walks] : cases) {
        NextFrameIndex = next;
        ShowStarted = started;
        RandomWalkActive = randomWalk;
        record.clear();
        StageClick(stage, static_cast<LPARAM>(MAKELONG(600, 600)));
        EXPECT_EQ(events({"walk", "walk_refused"}).size(), walks) << next << started;
        StopWalkTimer(stage);
    }
}

#include "stage/walk.h"

#include "stage/character.h"
#include "tests/stage/stage_fixture.h"
#include "toon/settings.h"

using testing::ElementsAre;

namespace {

class Walk : public StageTest {};

} // namespace

TEST_F(Walk, TicksByTheSpeedOfTheToon) {
    const LONG cases[][2] = {{-7, 190}, {0, 190}, {1, 190}, {2, 170},
                             {3, 150},  {4, 130}, {5, 110}, {9, 110}};
    for (const auto& one : cases) {
        ToonSpeed = one[0];
        const std::int64_t begun = seam::clockNow() - opened;
        ASSERT_NE(WalkTo(stage, 0, 0, 5, 0, 0), 0U);
        // One stride: two entries and a tick in which the pose stands.
        runTo(begun + 3 * one[1] - 1);
        EXPECT_EQ(count("walk_done"), 0) << "speed " << one[0];
        runTo(begun + 3 * one[1]);
        EXPECT_EQ(count("walk_done"), 1) << "speed " << one[0];
        Record.clear();
    }
}

TEST_F(Walk, CountsItsPacesAndItsDirection) {
    const struct {
        LONG toX;
        LONG toY;
        DWORD paces;
        LONG direction;
    } cases[] = {{0, 0, 0, 2}, {19, 0, 0, 1}, {100, 0, 2, 1}, {-200, 0, 4, 2}, {0, 100, 2, 2}};

    for (const auto& one : cases) {
        PacesWalked = 0;
        WalkTo(stage, 0, 0, one.toX, one.toY, 0);
        EXPECT_EQ(PacesWalked, one.paces) << one.toX;
        EXPECT_EQ(WalkDirection, one.direction) << one.toX;
        StopWalkTimer(stage);
    }
}

TEST_F(Walk, TellsOfItself) {
    WalkTo(stage, -150, 300, 435, 235, 9);
    EXPECT_THAT(
        events({"walk", "timer_set"}),
        ElementsAre("timer_set timer=WALK id=101 ms=150",
                    "walk from=[-150,300] to=[435,235] n=32 step=[18,-2] last=33 dir=1 pose=7 "
                    "interval=150 paces=8"));
}

TEST_F(Walk, AskedForDuringAnotherIsRefusedWithoutATrace) {
    WalkTo(stage, 0, 0, 100, 0, 0);
    EXPECT_EQ(WalkTo(stage, 0, 0, -500, 0, 0), 0U);
    EXPECT_EQ(PacesWalked, 2U);
    EXPECT_EQ(WalkDirection, WALK_TO_RIGHT);
    EXPECT_EQ(WalkLastIndex, 9);
    EXPECT_EQ(events({"walk_refused"}).front(), "walk_refused to=[-500,0]");
}

TEST_F(Walk, ShowsEveryEntryOnceThoughStoppedOnItsWay) {
    CharacterSprite.x = CharacterSprite.drawX = 300;
    CharacterSprite.y = CharacterSprite.drawY = 300;
    WalkTo(stage, 0, 0, 80, 0, 2);
    runTo(450);
    StopWalkTimer(stage);
    runTo(5000);
    EXPECT_NE(ResumeWalkTimer(stage), 0U);
    EXPECT_EQ(ResumeWalkTimer(stage), 0U);
    runTo(20000);
    EXPECT_THAT(
        events({"draw", "walk_done"}),
        ElementsAre("draw i=1 bitmap=fdltn2 at=[310,300]", "draw i=2 bitmap=fdl2r3 at=[320,300]",
                    "draw i=3 bitmap=fdl2r4 at=[330,300]", "draw i=4 bitmap=fdl2r5 at=[340,300]",
                    "draw i=5 bitmap=fdl2r6 at=[350,300]", "draw i=6 bitmap=fdl2r7 at=[360,300]",
                    "draw i=7 bitmap=fdltn1 at=[370,300]", "draw i=8 bitmap=fdltn2 at=[380,300]",
                    "draw i=9 bitmap=pose03 at=[380,300]", "walk_done"));
}

TEST_F(Walk, ATickOfAStoppedWalkEndsIt) {
    WalkTo(stage, 0, 0, 80, 0, 2);
    runTo(200);
    StopWalkTimer(stage);
    WalkStep(stage);
    EXPECT_EQ(count("walk_done"), 1);
    EXPECT_EQ(WalkStepIndex, 0);
}

TEST_F(Walk, AStoppedWalkIsReplacedByTheNext) {
    WalkTo(stage, 0, 0, 80, 0, 2);
    runTo(200);
    StopWalkTimer(stage);
    EXPECT_NE(WalkTo(stage, 0, 0, 400, 0, 2), 0U);
    EXPECT_EQ(WalkLastIndex, 25);
    EXPECT_EQ(WalkStepIndex, 0);
}

TEST_F(Walk, LeavesNoTrailOnTheBackdrop) {
    const RECT all = {0, 0, 1024, 768};
    const std::vector<DWORD> empty = pixels(all);
    WalkTo(stage, CharacterSprite.drawX, CharacterSprite.drawY, 300, 200, 0);
    ASSERT_TRUE(runUntilEvent("walk_done"));
    EXPECT_NE(pixels(all), empty);
    WalkTo(stage, CharacterSprite.drawX, CharacterSprite.drawY, -150, 500, 0);
    ASSERT_TRUE(runUntilEvent("walk_done"));
    EXPECT_EQ(pixels(all), empty);
}

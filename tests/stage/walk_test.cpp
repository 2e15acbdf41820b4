// Walks: their plan, which needs no window, and how they are acted out.
#include "stage/walk.h"

#include "stage/character.h"
#include "tests/stage/stage_fixture.h"
#include "toon/settings.h"

#include <cstdint>
#include <limits>

using testing::ElementsAre;

namespace {

constexpr LONG lowest = std::numeric_limits<LONG>::min();
constexpr LONG highest = std::numeric_limits<LONG>::max();

LONG plan(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG pose = 0, LONG step = WALK_STRIDE) {
    static HBITMAP art[CHARACTER_PICTURES]; // the handles tell their slot; nobody follows them
    for (int slot = 0; slot < CHARACTER_PICTURES; ++slot) {
        art[slot] = HBITMAP{HGDIOBJ{static_cast<DWORD>(slot)}};
    }
    return BuildWalkPath(fromX, fromY, toX, toY, step, &CharacterSprite, art, pose);
}

std::string slots() {
    std::string text;
    for (LONG entry = 0; entry <= WalkLastIndex; ++entry) {
        text += std::to_string(WalkPath[entry].bitmap.number) + ' ';
    }
    return text;
}

class Walk : public StageTest {};

} // namespace

TEST(WalkPlan, HasAStrideOrAMultipleOfEightAndStopsShortByTheRemainder) {
    const struct {
        LONG toX;
        LONG toY;
        LONG step;
        LONG strides;
        LONG endX;
        LONG endY;
    } cases[] = {
        {0, 0, 20, 1, 0, 0},           {19, -3, 20, 1, 19, -3},     {20, 0, 20, 8, 16, 0},
        {-23, -15, 20, 8, -16, -8},    {179, 0, 20, 8, 176, 0},     {180, 0, 20, 16, 176, 0},
        {-340, 0, 20, 24, -336, 0},    {0, 4839, 20, 248, 0, 4712}, {4980, 0, 20, 248, 4960, 0},
        {90000, 0, 20, 248, 89776, 0}, {7, 0, 1, 8, 0, 0},          {7, 0, -3, 8, 0, 0}};

    for (const auto& one : cases) {
        SCOPED_TRACE(std::to_string(one.toX) + "," + std::to_string(one.toY));
        EXPECT_EQ(plan(0, 0, one.toX, one.toY, 0, one.step), one.strides + 1);
        EXPECT_EQ(WalkLastIndex, one.strides + 1);
        for (const LONG last : {one.strides, one.strides + 1}) { // the pose moves no further
            EXPECT_EQ(WalkPath[last].x, one.endX);
            EXPECT_EQ(WalkPath[last].y, one.endY);
        }
    }
}

TEST(WalkPlan, TakesPicturesByTheCycleAndTurnsAtBothEnds) {
    plan(-150, 300, 435, 235, 3);
    EXPECT_EQ(slots(), "16 17 2 3 4 5 6 7 1 2 3 4 5 6 7 1 2 3 4 5 6 7 1 2 3 4 5 6 7 1 2 16 17 23 ");
    plan(100, 0, 0, 0);
    EXPECT_EQ(slots(), "18 19 10 11 12 13 14 18 19 20 ");
    plan(5, 5, 5, 15);
    EXPECT_EQ(slots(), "18 19 20 ") << "straight down counts as to the left";
}

TEST(WalkPlan, GoesAllTheWayAcrossWhatAFileCanHold) {
    EXPECT_EQ(plan(lowest, highest, highest, lowest), 249);
    for (LONG entry = 1; entry <= 248; ++entry) {
        ASSERT_GT(WalkPath[entry].x, WalkPath[entry - 1].x) << entry;
        ASSERT_LT(WalkPath[entry].y, WalkPath[entry - 1].y) << entry;
    }
    EXPECT_LT(static_cast<std::int64_t>(highest) - WalkPath[248].x, 248);
}

TEST(OffStage, TheMiddleBelongsToTheRight) {
    const LONG cases[][3] = {{1024, 511, -150}, {1024, 512, 1074}, {1025, 512, 1075}, {0, 0, 50}};
    for (const auto& one : cases) {
        EXPECT_EQ(OffStageX(one[0], one[1]), one[2]) << one[0] << ' ' << one[1];
    }
}

TEST_F(Walk, CountsAQuarterOfItsEntriesAndKnowsItsDirectionAndPace) {
    const struct {
        LONG toX;
        LONG toY;
        LONG speed;
        DWORD paces;
        LONG direction;
        LONG interval;
    } cases[] = {{0, 0, -7, 0, WALK_TO_LEFT, 190},
                 {19, 0, 0, 0, WALK_TO_RIGHT, 190},
                 {100, 0, 2, 2, WALK_TO_RIGHT, 170},
                 {-200, 0, 5, 4, WALK_TO_LEFT, 110},
                 {0, 100, 9, 2, WALK_TO_LEFT, 110}};

    for (const auto& one : cases) {
        SCOPED_TRACE(std::to_string(one.toX) + "," + std::to_string(one.toY));
        PacesWalked = 0;
        ToonSpeed = one.speed;
        WalkTo(stage, 0, 0, one.toX, one.toY, 0);
        EXPECT_EQ(PacesWalked, one.paces);
        EXPECT_EQ(WalkDirection, one.direction);
        EXPECT_EQ(WalkInterval, one.interval);
        StopWalkTimer(stage);
    }
}

TEST_F(Walk, AskedForDuringAnotherIsRefusedWithoutATrace) {
    WalkTo(stage, 0, 0, 100, 0, 0);
    pass(300);
    EXPECT_EQ(WalkTo(stage, 0, 0, -500, 0, 0), 0U);
    EXPECT_EQ(PacesWalked, 2U);
    EXPECT_EQ(WalkDirection, WALK_TO_RIGHT);
    EXPECT_EQ(WalkLastIndex, 9);
    EXPECT_EQ(WalkStepIndex, 2);
    EXPECT_EQ(WalkPath[1].x, 12);
    StopWalkTimer(stage);
    EXPECT_NE(WalkTo(stage, 0, 0, -500, 0, 0), 0U) << "a stopped one is replaced";
    EXPECT_EQ(WalkLastIndex, 33);
    EXPECT_EQ(WalkStepIndex, 0);
}

TEST_F(Walk, ShowsEveryEntryOnceThoughStoppedOnItsWay) {
    stand(300, 300);
    WalkTo(stage, 0, 0, 80, 0, 2);
    pass(450);
    StopWalkTimer(stage);
    pass(5000);
    EXPECT_NE(ResumeWalkTimer(stage), 0U);
    EXPECT_EQ(ResumeWalkTimer(stage), 0U);
    pass(20000);
    EXPECT_THAT(
        events({"draw", "walk_done"}),
        ElementsAre("draw i=1 bitmap=fdltn2 at=[310,300]", "draw i=2 bitmap=fdl2r3 at=[320,300]",
                    "draw i=3 bitmap=fdl2r4 at=[330,300]", "draw i=4 bitmap=fdl2r5 at=[340,300]",
                    "draw i=5 bitmap=fdl2r6 at=[350,300]", "draw i=6 bitmap=fdl2r7 at=[360,300]",
                    "draw i=7 bitmap=fdltn1 at=[370,300]", "draw i=8 bitmap=fdltn2 at=[380,300]",
                    "draw i=9 bitmap=pose03 at=[380,300]", "walk_done"));
    WalkTo(stage, 0, 0, 80, 0, 2);
    StopWalkTimer(stage);
    WalkStep(stage);
    EXPECT_EQ(count("walk_done"), 2U) << "a tick of a stopped walk ends it";
}

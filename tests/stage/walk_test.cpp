// Walks: their plan, which needs no window, and what stops and resumes them. What he shows on his
// way stands in the recorded shows.
#include "stage/walk.h"

#include "tests/stage/stage_fixture.h"

#include <cstdint>
#include <limits>

namespace {

constexpr LONG lowest = std::numeric_limits<LONG>::min();
constexpr LONG highest = std::numeric_limits<LONG>::max();

LONG plan(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG step = WALK_STRIDE) {
    static const HBITMAP art[CHARACTER_PICTURES] = {};
    return BuildWalkPath(fromX, fromY, toX, toY, step, &CharacterSprite, art, 0);
}

class Walk : public StageTest {};

} // namespace

TEST(WalkPlan, HasAStrideOrAMultipleOfEightAndStopsShortByTheRemainder) {
    const std::tuple<LONG, LONG, LONG, LONG, LONG, LONG> cases[] = {
        {0, 0, 20, 1, 0, 0},           {19, -3, 20, 1, 19, -3},     {20, 0, 20, 8, 16, 0},
        {-23, -15, 20, 8, -16, -8},    {179, 0, 20, 8, 176, 0},     {180, 0, 20, 16, 176, 0},
        {-340, 0, 20, 24, -336, 0},    {0, 4839, 20, 248, 0, 4712}, {4980, 0, 20, 248, 4960, 0},
        {90000, 0, 20, 248, 89776, 0}, {7, 0, 1, 8, 0, 0},          {7, 0, -3, 8, 0, 0}};
    for (const auto& [toX, toY, step, strides, endX, endY] : cases) {
        SCOPED_TRACE(std::to_string(toX) + "," + std::to_string(toY));
        EXPECT_EQ(plan(0, 0, toX, toY, step), strides + 1);
        for (const LONG last : {strides, strides + 1}) { // the pose moves no further
            EXPECT_EQ(WalkPath[last].x, endX);
            EXPECT_EQ(WalkPath[last].y, endY);
        }
    }
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
    for (const auto& [width, x, side] : cases) {
        EXPECT_EQ(OffStageX(width, x), side) << width << ' ' << x;
    }
}

TEST_F(Walk, HasAnIntervalForEachSpeedAndTheNearestForOthers) {
    for (const auto& [speed, interval] : {std::pair(-7, 190), {0, 190}, {2, 170}, {9, 110}}) {
        ToonSpeed = speed;
        WalkTo(stage, 0, 0, 100, 0, 0);
        EXPECT_EQ(WalkInterval, interval) << speed;
        StopWalkTimer(stage);
    }
}

TEST_F(Walk, ShowsEveryEntryOnceThoughStoppedOnItsWay) {
    WalkTo(stage, 0, 0, 80, 0, 2);
    pass(450);
    StopWalkTimer(stage);
    pass(5000);
    EXPECT_NE(ResumeWalkTimer(stage), 0U);
    EXPECT_EQ(ResumeWalkTimer(stage), 0U);
    pass(20000);
    EXPECT_EQ(count("draw"), 9U);
    EXPECT_EQ(count("walk_done"), 1U);
    WalkTo(stage, 0, 0, 80, 0, 2);
    StopWalkTimer(stage);
    WalkStep(stage);
    EXPECT_EQ(count("walk_done"), 2U) << "a tick of a stopped walk ends it";
}

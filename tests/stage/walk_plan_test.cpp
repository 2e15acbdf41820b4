// Plans of walks, which need no window.
#include "stage/character.h"
#include "stage/stage.h"
#include "stage/walk.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <string>

namespace {

constexpr LONG lowest = std::numeric_limits<LONG>::min();
constexpr LONG highest = std::numeric_limits<LONG>::max();

/// Art whose handles tell their slot; nobody follows them.
const HBITMAP* numberedArt() {
    static HBITMAP art[CHARACTER_PICTURES];
    for (int slot = 0; slot < CHARACTER_PICTURES; ++slot) {
        art[slot] = HBITMAP{HGDIOBJ{static_cast<DWORD>(slot + 1)}};
    }
    return art;
}

LONG plan(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG pose = 0, LONG step = WALK_STRIDE) {
    WalkTimerRunning = 0;
    return BuildWalkPath(fromX, fromY, toX, toY, step, &CharacterSprite, numberedArt(), pose);
}

std::string slots() {
    std::string text;
    for (LONG entry = 0; entry <= WalkLastIndex; ++entry) {
        text += std::to_string(static_cast<int>(WalkPath[entry].bitmap.number) - 1) + ' ';
    }
    return text;
}

} // namespace

TEST(WalkPlan, HasAStrideOrAMultipleOfEightOfThem) {
    const struct {
        LONG toX;
        LONG step;
        LONG strides;
    } cases[] = {{0, 20, 1},        {19, 20, 1},        {-19, 20, 1},    {20, 20, 8},
                 {179, 20, 8},      {180, 20, 16},      {339, 20, 16},   {340, 20, 24},
                 {-340, 20, 24},    {4979, 20, 248},    {4980, 20, 248}, {90000, 20, 248},
                 {lowest, 20, 248}, {highest, 20, 248}, {7, 1, 8},       {7, 0, 8},
                 {7, -3, 8}};

    for (const auto& one : cases) {
        EXPECT_EQ(plan(0, 0, one.toX, 0, 0, one.step), one.strides + 1)
            << one.toX << '/' << one.step;
        EXPECT_EQ(WalkLastIndex, one.strides + 1);
        EXPECT_EQ(WalkStepIndex, 0);
    }
    EXPECT_EQ(plan(lowest, lowest, highest, highest), 249);
}

TEST(WalkPlan, TakesPicturesByTheCycleAndTurnsAtBothEnds) {
    plan(-150, 300, 435, 235, 3);
    EXPECT_EQ(slots(), "16 17 2 3 4 5 6 7 1 2 3 4 5 6 7 1 2 3 4 5 6 7 1 2 3 4 5 6 7 1 2 16 17 23 ");
    EXPECT_EQ(WalkPath[1].x, -168 + 36); // 18 to the right, 2 up
    EXPECT_EQ(WalkPath[1].y, 298);
    EXPECT_EQ(WalkPath[32].x, 426);
    EXPECT_EQ(WalkPath[32].y, 236);
    EXPECT_EQ(WalkPath[33].x, 426);
    EXPECT_EQ(WalkPath[33].y, 236);
    plan(100, 0, 0, 0);
    EXPECT_EQ(slots(), "18 19 10 11 12 13 14 18 19 20 ");
}

TEST(WalkPlan, TurnsToTheLeftUnlessTheTargetLiesToTheRight) {
    plan(5, 5, 5, 5);
    EXPECT_EQ(slots(), "18 19 20 ");
    plan(5, 5, 5, 15);
    EXPECT_EQ(slots(), "18 19 20 ");
    plan(5, 5, 6, 5);
    EXPECT_EQ(slots(), "16 17 20 ");
}

TEST(WalkPlan, ReachesTheTargetOnlyWithoutRemainder) {
    plan(0, 0, 19, -3);
    EXPECT_EQ(WalkPath[1].x, 19);
    EXPECT_EQ(WalkPath[1].y, -3);
    plan(0, 0, 20, 0);
    EXPECT_EQ(WalkPath[8].x, 16);
    plan(0, 0, -23, -15); // 8 strides of (-2, -1)
    EXPECT_EQ(WalkPath[8].x, -16);
    EXPECT_EQ(WalkPath[8].y, -8);
}

TEST(WalkPlan, GoesAllTheWayAcrossWhatAFileCanHold) {
    plan(lowest, highest, highest, lowest);
    for (LONG entry = 1; entry <= 248; ++entry) {
        ASSERT_GT(WalkPath[entry].x, WalkPath[entry - 1].x) << entry;
        ASSERT_LT(WalkPath[entry].y, WalkPath[entry - 1].y) << entry;
    }
    EXPECT_LT(static_cast<std::int64_t>(highest) - WalkPath[248].x, 248);
}

TEST(WalkPlan, HoldsThePoseToTheEightThereAre) {
    const LONG cases[][2] = {{-1, 20}, {lowest, 20}, {0, 20},      {7, 27},
                             {8, 27},  {9, 27},      {highest, 27}};
    for (const auto& one : cases) {
        plan(0, 0, 0, 0, one[0]);
        EXPECT_EQ(WalkPath[2].bitmap, numberedArt()[one[1]]) << one[0];
    }
}

TEST(WalkPlan, LeavesARunningWalkAlone) {
    plan(0, 0, 100, 0);
    WalkStepIndex = 4;
    WalkTimerRunning = 1;
    EXPECT_EQ(BuildWalkPath(9, 9, 900, 9, WALK_STRIDE, &CharacterSprite, numberedArt(), 5), 0);
    EXPECT_EQ(WalkLastIndex, 9);
    EXPECT_EQ(WalkStepIndex, 4);
    EXPECT_EQ(WalkPath[1].x, 12);
    WalkTimerRunning = 0;
    EXPECT_EQ(BuildWalkPath(9, 9, 900, 9, WALK_STRIDE, &CharacterSprite, numberedArt(), 5), 49);
    WalkStepIndex = 0;
}

TEST(OffStage, TheMiddleBelongsToTheRight) {
    const LONG cases[][3] = {{1024, 511, -150},    {1024, 512, 1074},     {1025, 512, 1075},
                             {1024, lowest, -150}, {1024, highest, 1074}, {0, 0, 50}};
    for (const auto& one : cases) {
        EXPECT_EQ(OffStageX(one[0], one[1]), one[2]) << one[0] << ' ' << one[1];
    }
}

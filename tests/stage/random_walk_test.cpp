#include "stage/random_walk.h"

#include "stage/bubble.h"
#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/player.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"
#include "toon/settings.h"

#include <algorithm>
#include <cstring>
#include <set>

using testing::ElementsAre;
using testing::IsEmpty;
using testing::StartsWith;

namespace {

class RandomWalk : public StageTest {
  protected:
    /// Chooses a walk with nothing else going on, and drops it again.
    void pick(DWORD allowStatements) const {
        ASSERT_EQ(PickRandomWalk(stage, allowStatements), 1);
        StopWalkTimer(stage);
        RandomWalkActive = 0;
    }
};

} // namespace

TEST(RandomNumbers, AreTheSameForASeedUnderEveryCompiler) {
    SeedRandom(1);
    for (const LONG expected : {1366, 3267, 2360, 3055, 0}) {
        EXPECT_EQ(RandomInt(0, RANDOM_HIGHEST), expected);
    }
}

TEST(RandomNumbers, KeepBothBounds) {
    std::set<LONG> seen;
    for (int draw = 0; draw < 200; ++draw) {
        seen.insert(RandomInt(3, 5));
    }
    EXPECT_EQ(seen, (std::set<LONG>{3, 4, 5}));
    EXPECT_EQ(RandomInt(77, 77), 77);
    EXPECT_LE(RandomInt(3000, 100000), RANDOM_HIGHEST);
    EXPECT_GE(RandomInt(-50, 3276), 0);
}

TEST(RandomNumbers, GiveTheLowerOfBoundsThatCannotBeMet) {
    const LONG cases[][2] = {{5, 4}, {3277, 9000}, {-9, -2}, {1, -1}, {0, -5}};
    for (const auto& one : cases) {
        EXPECT_EQ(RandomInt(one[0], one[1]), one[0]);
    }
}

TEST_F(RandomWalk, ChoosesPlacesWithinTheStageOnBothSidesOfTheMiddle) {
    std::set<bool> sides;
    for (int walk = 0; walk < 200; ++walk) {
        pick(0);
        const bool lowerRight = WalkFrame.x > 412;
        sides.insert(lowerRight);
        EXPECT_TRUE(lowerRight ? WalkFrame.x >= 413 && WalkFrame.x <= 824 && WalkFrame.y >= 285 &&
                                     WalkFrame.y <= 568
                               : WalkFrame.x >= 0 && WalkFrame.x <= 411 && WalkFrame.y >= 0 &&
                                     WalkFrame.y <= 283)
            << WalkFrame.x << ' ' << WalkFrame.y;
        EXPECT_TRUE(WalkFrame.pose >= 0 && WalkFrame.pose <= 7 && WalkFrame.pause == 5);
    }
    EXPECT_EQ(sides.size(), 2U);
}

TEST_F(RandomWalk, FindsAPlaceOnATinyStage) {
    openStage(120, 90);
    for (int walk = 0; walk < 20; ++walk) {
        pick(0);
        EXPECT_TRUE((WalkFrame.x == 0 || WalkFrame.x == 2) && WalkFrame.x == WalkFrame.y);
    }
}

TEST_F(RandomWalk, NeverSaysTheSameTwiceInARow) {
    int paces = 0;
    int winks = 0;
    PreviousStatement = 0;
    for (int walk = 0; walk < 500; ++walk) {
        const LONG before = PreviousStatement;
        pick(1);
        EXPECT_NE(PreviousStatement, before);
        EXPECT_TRUE(PreviousStatement == STATEMENT_PACES ||
                    (PreviousStatement >= FIRST_STATEMENT && PreviousStatement <= LastStatementId));
        paces += PreviousStatement == STATEMENT_PACES ? 1 : 0;
        winks += WalkFrame.wink;
    }
    EXPECT_TRUE(paces > 5 && paces < 45) << paces;   // 4 of 100
    EXPECT_TRUE(winks > 80 && winks < 170) << winks; // 25 of 101
}

TEST_F(RandomWalk, TellsHisPacesAlsoWhereStatementsAreSwitchedOff) {
    std::set<LONG> seen;
    for (int walk = 0; walk < 200; ++walk) {
        pick(0);
        seen.insert(PreviousStatement);
        EXPECT_EQ(WalkFrame.text[0] == '\0', PreviousStatement == STATEMENT_NONE);
    }
    EXPECT_EQ(seen, (std::set<LONG>{STATEMENT_PACES, STATEMENT_NONE}));
    PacesWalked = 4294967295U;
    BuildPacesStatement();
    EXPECT_STREQ(WalkFrame.text, "Since starting here, I've walked a total of 4294967295 Paces!!");
}

TEST_F(RandomWalk, RefusedDrawsNoNumber) {
    const auto refused = [&](const char* why) {
        SeedRandom(1);
        EXPECT_EQ(PickRandomWalk(stage, 1), 0) << why;
        EXPECT_EQ(RandomInt(0, RANDOM_HIGHEST), 1366) << why;
    };
    NextFrameIndex = 1;
    refused("a show");
    NextFrameIndex = 0;
    ShowStarted = 1;
    refused("a show stopped at its first frame");
    ShowStarted = 0;
    EditorDialog = stage;
    refused("the frame editor");
    EditorDialog = nullptr;
    WalkTo(stage, 0, 0, 300, 0, 0);
    refused("a click's walk");
    EXPECT_EQ(count("random_walk_refused"), 4);
}

TEST_F(RandomWalk, ComesInSpeaksAndLeavesByTheSideFromWhichHeCame) {
    WalkFrame = frame(600, 300, 2, 2, 0, "");
    ASSERT_EQ(PrepareRandomWalk(stage, 8), 1);
    EXPECT_STREQ(WalkFrame.text, "This statement is completely false!");
    WalkToRandomFrame(stage);
    EXPECT_EQ(PrepareRandomWalk(stage, 9), 0);
    EXPECT_STREQ(WalkFrame.text, "This statement is completely false!");
    EXPECT_EQ(events({"enter"}).front(), "enter draw=[1074,300] side=right");
    ASSERT_TRUE(runUntilEvent("bubble_show"));
    ASSERT_TRUE(runUntilEvent("tick timer=PAUSE"));
    EXPECT_EQ(count("bubble_hide"), 1);
    EXPECT_THAT(events({"walk"}).front(), StartsWith("walk from=[600,300] to=[1074,300]"));
    EXPECT_EQ(WalkingOut, 1U);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_EQ(count("show_done"), 1);
    EXPECT_EQ(RandomWalkActive + WalkingOut, 0U);
    EXPECT_EQ(seam::liveHandles().timers, 0U);
    EXPECT_THAT(HostCalls, ElementsAre("DisableButtons", "RestoreButtons"));
}

TEST_F(RandomWalk, TheFirstOneEndsTwiceAndTheSecondEndStartsTheNext) {
    OpeningDone = 0;
    OnShowDone = [this] {
        ResetShow(stage);
        PickRandomWalk(stage, 1);
    };
    ASSERT_EQ(PickRandomWalk(stage, 1), 1);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_EQ(OpeningDone, 1U);
    const std::vector<std::string> seen =
        events({"show_done", "random_walk", "random_walk_refused", "invalidate", "walk"});
    ASSERT_EQ(seen.size(), 8U);
    EXPECT_EQ(seen[1], "show_done"); // after the walk out
    EXPECT_EQ(seen[3], "random_walk_refused");
    EXPECT_EQ(seen[4], "invalidate");
    EXPECT_EQ(seen[5], "show_done");
    EXPECT_THAT(seen[7], StartsWith("walk "));
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_EQ(count("show_done"), 1);
}

TEST_F(RandomWalk, TheEditorsFirstWalkTellsThePacesInPoseSix) {
    OpeningDone = 0;
    ASSERT_EQ(StartOpeningWalk(stage), 1);
    EXPECT_EQ(events({"random_walk"}).front(),
              "random_walk target=[412,384] pose=6 wink=1 statement=-1");
    EXPECT_EQ(WalkFrame.pause, 7);
    EXPECT_STREQ(WalkFrame.text, "Since starting here, I've walked a total of 0 Paces!!");
    EXPECT_EQ(StartOpeningWalk(stage), 0);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_EQ(StartOpeningWalk(stage), 0);
}

TEST_F(RandomWalk, ThePreviewWalksOnceAndStaysStill) {
    OpeningDone = 0;
    PreviewMode = 1;
    openStage(150, 110);
    OnShowDone = [this] {
        ResetShow(stage);
        StartPreviewWalk(stage);
    };
    ASSERT_EQ(StartPreviewWalk(stage), 1);
    EXPECT_EQ(events({"random_walk"}).front(),
              "random_walk target=[10,0] pose=6 wink=1 statement=0");
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_EQ(count("show_done"), 2);
    EXPECT_EQ(count("random_walk_refused"), 2);
    EXPECT_EQ(seam::liveHandles().timers, 0U);
}

TEST_F(RandomWalk, TheOpeningWalkDoesNotStartOverAShow) {
    OpeningDone = 0;
    openToon({frame(500, 400, 0, 3, 0, "")});
    PlayNextFrame(stage);
    EXPECT_EQ(StartOpeningWalk(stage), 0);
    ASSERT_TRUE(runUntilEvent("timer_set timer=PAUSE"));
    EXPECT_EQ(StartOpeningWalk(stage), 0);
    EXPECT_EQ(RandomWalkActive, 0U);
}

TEST_F(RandomWalk, PlacesAreScaledAsThoseOfTheOpenToonAndTheSideIsNot) {
    openToon({frame(0, 0, 0, 1, 0, "")});
    ToonDocHeader.windowSize = MAKELONG(512, 768);
    WalkFrame = frame(300, 200, 0, 1, 0, "");
    PrepareRandomWalk(stage, STATEMENT_NONE);
    WalkToRandomFrame(stage);
    EXPECT_THAT(events({"walk"}).front(), StartsWith("walk from=[-150,200] to=[600,200]"));
}

TEST(StatementTable, HoldsSixtyTwoThatFitTheBubble) {
    std::size_t shortest = 70;
    std::size_t longest = 0;
    int broken = 0;
    std::set<std::string> all;
    for (LONG id = FIRST_STATEMENT; id <= LastStatementId; ++id) {
        char text[TOON_TEXT_SIZE] = {};
        const auto length = static_cast<std::size_t>(
            LoadStringA(GetModuleHandleA(nullptr), static_cast<UINT>(id), text, sizeof(text)));
        EXPECT_EQ(length, std::strlen(text)) << id;
        shortest = std::min(shortest, length);
        longest = std::max(longest, length);
        const auto returns = std::count(text, text + length, '\r');
        EXPECT_LE(returns, 2) << id;
        EXPECT_EQ(std::strpbrk(text, "\n\\\t"), nullptr) << id;
        broken += returns != 0 ? 1 : 0;
        all.insert(text);
    }
    EXPECT_EQ(shortest, 31U);
    EXPECT_EQ(longest, 67U);
    EXPECT_EQ(broken, 9);
    EXPECT_EQ(all.size(), 62U);
    EXPECT_EQ(all.count("24 hours in a day,\r24 beers in a case,\rCoincidence?"), 1U);
}

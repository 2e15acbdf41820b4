#include "stage/editor_host.h"
#include "stage/player.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

#include <cstring>
#include <set>

using testing::ElementsAre;
using testing::StartsWith;

namespace {

testing::Matcher<LONG> isBetween(LONG low, LONG high) {
    return testing::AllOf(testing::Ge(low), testing::Le(high));
}

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

TEST(RandomNumbers, KeepBothBoundsAndGiveTheLowerIfTheyCannotBeMet) {
    std::set<LONG> seen;
    for (int draw = 0; draw < 200; ++draw) {
        seen.insert(RandomInt(3, 5));
    }
    EXPECT_EQ(seen, (std::set<LONG>{3, 4, 5}));
    EXPECT_LE(RandomInt(3000, 100000), RANDOM_HIGHEST);
    EXPECT_GE(RandomInt(-50, 3276), 0);
    const LONG cases[][2] = {{77, 77}, {5, 4}, {3277, 9000}, {-9, -2}};
    for (const auto& [low, high] : cases) {
        EXPECT_EQ(RandomInt(low, high), low);
    }
}

TEST_F(RandomWalk, ChoosesPlacesWithinTheStageOnBothSidesOfTheMiddle) {
    std::set<bool> sides;
    for (int walk = 0; walk < 200; ++walk) {
        pick(0);
        const bool lowerRight = WalkFrame.x > 412;
        sides.insert(lowerRight);
        EXPECT_THAT(WalkFrame.x, lowerRight ? isBetween(413, 824) : isBetween(0, 411));
        EXPECT_THAT(WalkFrame.y, lowerRight ? isBetween(285, 568) : isBetween(0, 283));
        EXPECT_THAT(WalkFrame.pose, isBetween(0, 7));
        EXPECT_EQ(WalkFrame.pause, 5);
    }
    EXPECT_EQ(sides.size(), 2U);
    openStage(120, 90); // with no room for the margin
    pick(0);
    EXPECT_TRUE((WalkFrame.x == 0 || WalkFrame.x == 2) && WalkFrame.x == WalkFrame.y);
}

TEST_F(RandomWalk, NeverSaysTheSameTwiceInARow) {
    int paces = 0;
    int winks = 0;
    for (int walk = 0; walk < 500; ++walk) {
        const LONG before = PreviousStatement;
        pick(1);
        EXPECT_NE(PreviousStatement, before);
        EXPECT_TRUE(PreviousStatement == STATEMENT_PACES ||
                    (PreviousStatement >= FIRST_STATEMENT && PreviousStatement <= LastStatementId));
        paces += PreviousStatement == STATEMENT_PACES ? 1 : 0;
        winks += WalkFrame.wink;
    }
    EXPECT_EQ(paces, 17);  // with this seed, of 4 in 100
    EXPECT_EQ(winks, 117); // of 25 in 101
}

TEST_F(RandomWalk, TellsHisPacesAlsoWhereStatementsAreSwitchedOff) {
    std::set<std::string> said;
    for (int walk = 0; walk < 200; ++walk) {
        PacesWalked = 4294967295U;
        pick(0);
        said.insert(WalkFrame.text);
    }
    EXPECT_THAT(said, ElementsAre("", "Since starting here, I've walked a total of 4294967295 "
                                      "Paces!!"));
}

TEST_F(RandomWalk, RefusedDrawsNoNumber) {
    const auto refused = [&](const char* why) {
        SeedRandom(1);
        EXPECT_EQ(PickRandomWalk(stage, 1), 0) << why;
        EXPECT_EQ(RandomInt(0, RANDOM_HIGHEST), 1366) << why;
    };
    ShowStarted = 1;
    refused("a show stopped at its first frame");
    EXPECT_EQ(StartOpeningWalk(stage), 0) << "a show goes on";
    ShowStarted = 0;
    EditorDialog = stage;
    refused("the frame editor");
    EditorDialog = nullptr;
    WalkTo(stage, 0, 0, 300, 0, 0);
    refused("a click's walk");
}

TEST_F(RandomWalk, PlacesAreScaledAsThoseOfTheOpenToonAndTheSideIsNot) {
    openToon({{0, 0, 0, 1, 0, "", 0}});
    ToonDocHeader.windowSize = MAKELONG(512, 768);
    WalkFrame = {300, 200, 0, 1, 0, "", 0};
    PrepareRandomWalk(stage, STATEMENT_NONE);
    WalkToRandomFrame(stage);
    EXPECT_THAT(events({"walk"}), ElementsAre(StartsWith("walk from=[-150,200] to=[600,200] ")));
}

TEST(StatementTable, HoldsSixtyTwoThatFitTheBubble) {
    std::set<std::string> all;
    for (LONG id = FIRST_STATEMENT; id <= LastStatementId; ++id) {
        char text[TOON_TEXT_SIZE] = {};
        const int length =
            LoadStringA(GetModuleHandleA(nullptr), static_cast<UINT>(id), text, sizeof(text));
        EXPECT_THAT(length, isBetween(31, 67)) << id;
        EXPECT_EQ(std::strpbrk(text, "\n\\\t"), nullptr) << id;
        EXPECT_LE(std::count(text, text + length, '\r'), 2) << id;
        all.insert(text);
    }
    EXPECT_EQ(all.size(), 62U);
}

#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace {

class Click : public StageTest {
  protected:
    void click(LONG x, LONG y) const {
        StageClick(stage, static_cast<LPARAM>(MAKELONG(x, y)));
    }

    void stand(LONG x, LONG y) const {
        CharacterSprite.x = CharacterSprite.drawX = x;
        CharacterSprite.y = CharacterSprite.drawY = y;
    }
};

} // namespace

TEST_F(Click, BringsHisCentreToThePoint) {
    stand(100, 100);
    CharacterX = 7;
    click(420, 300);
    EXPECT_EQ(events({"walk"}).front().substr(0, 36), "walk from=[100,100] to=[355,235] n=1");
    EXPECT_EQ(CharacterX, 7);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_THAT(HostCalls, ElementsAre("SetPlayButton 0"));
}

TEST_F(Click, TakesCoordinatesAsSigned) {
    stand(500, 500);
    click(-20, -1);
    EXPECT_THAT(events({"walk"}).front(), testing::StartsWith("walk from=[500,500] to=[-85,-66]"));
    EXPECT_EQ(WalkDirection, WALK_TO_LEFT);
}

TEST_F(Click, OnHimDoesNothing) {
    stand(100, 100);
    for (const HWND editor : {HWND{}, stage}) {
        EditorDialog = editor;
        click(100, 100);
        click(229, 229);
        EXPECT_THAT(events({"walk"}), IsEmpty());
        EXPECT_THAT(HostCalls, IsEmpty());
    }
    click(230, 229);
    EXPECT_THAT(HostCalls, ElementsAre("SetEditedPosition 230 229"));
}

TEST_F(Click, DoesNothingWhileAShowIsUnderWay) {
    const struct {
        LONG next;
        DWORD started;
        DWORD randomWalk;
        std::size_t walks;
    } cases[] = {{0, 0, 0, 1}, {1, 1, 0, 0}, {0, 1, 0, 0}, {1, 0, 0, 0}, {0, 0, 1, 0}};

    for (const auto& one : cases) {
        stand(100, 100);
        NextFrameIndex = one.next;
        ShowStarted = one.started;
        RandomWalkActive = one.randomWalk;
        Record.clear();
        click(600, 600);
        EXPECT_EQ(events({"walk", "walk_refused"}).size(), one.walks) << one.next << one.started;
        StopWalkTimer(stage);
        EditorDialog = stage;
        HostCalls.clear();
        click(600, 600);
        EXPECT_THAT(HostCalls, ElementsAre("SetEditedPosition 600 600"));
        EditorDialog = nullptr;
    }
    RandomWalkActive = 0;
}

TEST_F(Click, DuringTheWalkOffIsRefused) {
    openToon({frame(500, 400, 0, 1, 0, "")});
    PlayNextFrame(stage);
    ASSERT_TRUE(runUntilEvent("walk_off"));
    click(20, 20);
    EXPECT_EQ(count("walk_refused"), 1);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_THAT(events({"walk"}), IsEmpty());
}

TEST_F(Click, ComesInFromHisParkingPlace) {
    click(200, 400);
    EXPECT_THAT(events({"walk"}).front(), testing::StartsWith("walk from=[-150,384] to=[135,335]"));
}

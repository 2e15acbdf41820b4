#include "stage/bubble.h"

#include "stage/character.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

using testing::ElementsAre;

namespace {

class Bubble : public StageTest {};

const RECT wholeStage = {0, 0, 1024, 768};

} // namespace

TEST_F(Bubble, StandsInFrontOfHimUnlessThereIsNoRoom) {
    const struct {
        int width;
        LONG anchor;
        LONG direction;
        LONG side;
    } cases[] = {{1024, 768, 1, 1}, {1024, 769, 1, 2}, {1024, 256, 2, 2}, {1024, 255, 2, 1},
                 {1024, 100, 1, 1}, {1024, 900, 2, 2}, {1024, 255, 0, 1}, {1024, 600, 0, 0},
                 {500, 340, 1, 1},  {500, 341, 1, 2},  {500, 160, 2, 2},  {500, 159, 2, 1},
                 {200, 100, 1, 2},  {200, 100, 2, 1}};

    for (const auto& one : cases) {
        MoveWindow(stage, 0, 0, one.width, 400, FALSE);
        ChooseBubbleSide(stage, one.anchor, 200, one.direction);
        EXPECT_EQ(BubbleSide, one.side) << one.width << ' ' << one.anchor << ' ' << one.direction;
        EXPECT_EQ(BubbleSprite.x, one.side == 1 ? one.anchor + 15 : one.anchor - 175);
        EXPECT_EQ(BubbleSprite.drawY, 150);
    }
}

TEST_F(Bubble, IsPlacedByWhereHeStandsAndCameFrom) {
    CharacterSprite.drawX = 400;
    CharacterSprite.drawY = 300;
    for (const LONG direction : {WALK_TO_RIGHT, WALK_TO_LEFT}) {
        WalkDirection = direction;
        PlaceBubble(stage);
        ShowBubble(stage, "Two\rlines");
        HideBubble(stage);
    }
    EXPECT_THAT(events({"bubble_place", "bubble_show", "bubble_hide"}),
                ElementsAre("bubble_place side=1 corner=[480,285] anchor=[465,335] bitmap=bubleft",
                            "bubble_show rect=[480,285,640,380] text_rect=[510,311,630,382] "
                            "text=Two\\rlines",
                            "bubble_hide rect=[480,285,640,380] shown=1",
                            "bubble_place side=2 corner=[290,285] anchor=[465,335] bitmap=bubright",
                            "bubble_show rect=[290,285,450,380] text_rect=[300,311,420,382] "
                            "text=Two\\rlines",
                            "bubble_hide rect=[290,285,450,380] shown=1"));
}

TEST_F(Bubble, ComesOffWithoutATrace) {
    const std::vector<DWORD> before = pixels(wholeStage);
    CharacterSprite.drawX = 400;
    CharacterSprite.drawY = 300;
    PlaceBubble(stage);
    EXPECT_EQ(pixels(wholeStage), before) << "placing draws nothing";
    ShowBubble(stage, "Words & words");
    EXPECT_EQ(BubbleHidden, 0U);
    EXPECT_NE(pixels(wholeStage), before);
    HideBubble(stage);
    EXPECT_EQ(BubbleHidden, 1U);
    EXPECT_EQ(pixels(wholeStage), before);
}

TEST_F(Bubble, HiddenTwicePutsNothingBackTheSecondTime) {
    CharacterSprite.drawX = 400;
    CharacterSprite.drawY = 300;
    PlaceBubble(stage);
    ShowBubble(stage, "Once");
    HideBubble(stage);
    const HDC dc = GetDC(stage);
    Rectangle(dc, 300, 280, 600, 400);
    ReleaseDC(stage, dc);
    const std::vector<DWORD> drawn = pixels(wholeStage);
    BubbleHidden = 0;
    HideBubble(stage);
    EXPECT_EQ(pixels(wholeStage), drawn);
    EXPECT_EQ(BubbleHidden, 1U);
}

TEST_F(Bubble, WritesItsTextInTheBodyOnly) {
    CharacterSprite.drawX = 400;
    CharacterSprite.drawY = 300;
    WalkDirection = WALK_TO_RIGHT;
    PlaceBubble(stage);
    ShowBubble(stage, "");
    const std::vector<DWORD> blank = pixels(wholeStage);
    const std::vector<DWORD> blankBody = pixels({510, 311, 630, 382});
    EXPECT_GT(DrawBubbleText(stage, "First\rsecond\rthird"), 2 * 14);
    EXPECT_NE(pixels({510, 311, 630, 382}), blankBody);
    const std::vector<DWORD> written = pixels(wholeStage);
    for (std::size_t pixel = 0; pixel < written.size(); ++pixel) {
        const auto x = static_cast<LONG>(pixel % 1024);
        const auto y = static_cast<LONG>(pixel / 1024);
        if (x < 510 || x >= 630 || y < 311 || y >= 382) {
            ASSERT_EQ(written[pixel], blank[pixel]) << x << ' ' << y;
        }
    }
}

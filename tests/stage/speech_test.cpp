// What he shows at a frame beyond himself: the cells of his face, and the bubble.
#include "stage/bubble.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

namespace {

class Speech : public StageTest {
  protected:
    void SetUp() override {
        StageTest::SetUp();
        stand(400, 300);
        WalkDirection = WALK_TO_RIGHT;
    }

    /// The pixels of one picture that another one has otherwise lie within this rectangle.
    void expectSameBut(const RECT& area, const std::vector<DWORD>& before) const {
        const std::vector<DWORD> now = pixels();
        for (std::size_t pixel = 0; pixel < now.size(); ++pixel) {
            const auto x = static_cast<LONG>(pixel % 1024);
            const auto y = static_cast<LONG>(pixel / 1024);
            if (x < area.left || x >= area.right || y < area.top || y >= area.bottom) {
                ASSERT_EQ(now[pixel], before[pixel]) << x << ' ' << y;
            }
        }
        EXPECT_NE(now, before);
    }
};

} // namespace

TEST_F(Speech, CopiesTheCellOfItsPoseOntoTheFace) {
    const std::vector<DWORD> before = pixels();
    PlayFrame = {0, 0, 3, 0, 1, "", 0};
    EXPECT_EQ(ShowExpression(stage, 4), 1);
    expectSameBut({455, 334, 465, 344}, before);
    const seam::Picture sheet = seam::bitmapPicture(ExpressionSheet);
    const std::vector<DWORD> now = pixels();
    for (int y = 0; y < 10; ++y) {
        const auto cell = sheet.pixels.begin() + (33 + y) * sheet.width + 33;
        const auto shown = now.begin() + (334 + y) * 1024 + 455;
        EXPECT_TRUE(std::equal(shown, shown + 10, cell, [](DWORD is, DWORD drawn) {
            return is == (drawn & 0xFFFFFF);
        })) << y;
    }
    EXPECT_EQ(StampFaceCell(stage, 0, 0, 0), 0);
}

TEST_F(Speech, TheBubbleStandsInFrontOfHimUnlessThereIsNoRoom) {
    const std::tuple<int, LONG, LONG, LONG> cases[] = {
        {1024, 768, 1, 1}, {1024, 769, 1, 2}, {1024, 256, 2, 2}, {1024, 255, 2, 1},
        {1024, 255, 0, 1}, {1024, 600, 0, 0}, {500, 340, 1, 1},  {500, 341, 1, 2},
        {500, 160, 2, 2},  {500, 159, 2, 1},  {200, 100, 1, 2},  {200, 100, 2, 1}};
    for (const auto& [width, anchor, direction, side] : cases) {
        MoveWindow(stage, 0, 0, width, 400, FALSE);
        ChooseBubbleSide(stage, anchor, 200, direction);
        EXPECT_EQ(BubbleSide, side) << width << ' ' << anchor << ' ' << direction;
        EXPECT_EQ(BubbleSprite.x, side == 1 ? anchor + 15 : anchor - 175);
        EXPECT_EQ(BubbleSprite.drawY, 150);
    }
}

TEST_F(Speech, TheBubbleComesOnAndOffWithoutATraceAndOffOnlyOnce) {
    const std::vector<DWORD> before = pixels();
    PlaceBubble(stage);
    EXPECT_EQ(pixels(), before) << "placing draws nothing";
    ShowBubble(stage, "Words & words");
    EXPECT_EQ(BubbleHidden, 0U);
    expectSameBut({480, 285, 640, 380}, before);
    HideBubble(stage);
    EXPECT_EQ(BubbleHidden, 1U);
    EXPECT_EQ(pixels(), before);
    const HDC dc = GetDC(stage);
    Rectangle(dc, 300, 280, 600, 400);
    ReleaseDC(stage, dc);
    const std::vector<DWORD> drawn = pixels();
    HideBubble(stage);
    EXPECT_EQ(pixels(), drawn) << "nothing is put back a second time";
}

TEST_F(Speech, ATextStaysInTheBubblesBody) {
    PlaceBubble(stage);
    ShowBubble(stage, "");
    const std::vector<DWORD> blank = pixels();
    EXPECT_GT(DrawBubbleText(stage, "First\rsecond\rthird"), 2 * 14);
    expectSameBut({510, 311, 630, 382}, blank);
}

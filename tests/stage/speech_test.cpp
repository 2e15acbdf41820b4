// What he shows at a frame beyond himself: the cells of his face, and the bubble.
#include "stage/bubble.h"
#include "stage/character.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

using testing::ElementsAre;

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
    EXPECT_THAT(events({"face"}), ElementsAre("face expr=4 src=[33,33] dst=[455,334]"));
    expectSameBut({455, 334, 465, 344}, before);
    const seam::Picture sheet = seam::bitmapPicture(ExpressionSheet);
    const std::vector<DWORD> now = pixels();
    for (int y = 0; y < 10; ++y) {
        for (int x = 0; x < 10; ++x) {
            const auto cell = static_cast<std::size_t>((33 + y) * sheet.width + 33 + x);
            const auto shown = static_cast<std::size_t>((334 + y) * 1024 + 455 + x);
            ASSERT_EQ(now[shown], sheet.pixels[cell] & 0xFFFFFF) << x << ' ' << y;
        }
    }
    EXPECT_EQ(StampFaceCell(stage, 0, 0, 0), 0);
}

TEST_F(Speech, TheBubbleStandsInFrontOfHimUnlessThereIsNoRoom) {
    const struct {
        int width;
        LONG anchor;
        LONG direction;
        LONG side;
    } cases[] = {{1024, 768, 1, 1}, {1024, 769, 1, 2}, {1024, 256, 2, 2}, {1024, 255, 2, 1},
                 {1024, 255, 0, 1}, {1024, 600, 0, 0}, {500, 340, 1, 1},  {500, 341, 1, 2},
                 {500, 160, 2, 2},  {500, 159, 2, 1},  {200, 100, 1, 2},  {200, 100, 2, 1}};

    for (const auto& one : cases) {
        MoveWindow(stage, 0, 0, one.width, 400, FALSE);
        ChooseBubbleSide(stage, one.anchor, 200, one.direction);
        EXPECT_EQ(BubbleSide, one.side) << one.width << ' ' << one.anchor << ' ' << one.direction;
        EXPECT_EQ(BubbleSprite.x, one.side == 1 ? one.anchor + 15 : one.anchor - 175);
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
    BubbleHidden = 0;
    HideBubble(stage);
    EXPECT_EQ(pixels(), drawn) << "nothing is put back a second time";
    EXPECT_EQ(BubbleHidden, 1U);
}

TEST_F(Speech, ATextStaysInTheBubblesBody) {
    PlaceBubble(stage);
    ShowBubble(stage, "");
    const std::vector<DWORD> blank = pixels();
    EXPECT_GT(DrawBubbleText(stage, "First\rsecond\rthird"), 2 * 14);
    expectSameBut({510, 311, 630, 382}, blank);
}

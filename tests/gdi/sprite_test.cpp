// Sprites on a stage in memory, every pixel compared. Black, '.', is see-through in a figure.
#include "platform/user.h"
#include "stage/sprite.h"
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

#include <memory>

using namespace test;

namespace {

std::unique_ptr<TestSurface> stage;

const Rows backdrop{"BcBcBcBc", "cYcYcYcY", "BcBcBcBc", "cYcYcYcY", "BcBcBcBc", "cYcYcYcY"};
const Rows ring{".R.", "R.R", ".R."};
const Rows cross{"M.M", ".M.", "M.M"};

/// The backdrop with a figure laid over it, as an artist would: the oracle of all that follows.
Rows with(const Rows& figure, LONG left, LONG top) {
    Rows picture = backdrop;
    for (std::size_t y = 0; y < figure.size(); ++y) {
        for (std::size_t x = 0; x < figure[y].size(); ++x) {
            const auto column = static_cast<std::size_t>(left) + x; // wraps where it is outside
            const auto row = static_cast<std::size_t>(top) + y;
            if (figure[y][x] != '.' && row < picture.size() && column < picture[row].size()) {
                picture[row][column] = figure[y][x];
            }
        }
    }
    return picture;
}

class Sprites : public testing::Test {
  protected:
    Sprites() : start_(liveObjects()), ring_(makeBitmap(ring)), cross_(makeBitmap(cross)) {
        stage = std::make_unique<TestSurface>(backdrop);
    }

    ~Sprites() override {
        SpriteFree(&sprite_);
        SpriteFree(&sprite_); // may come twice
        EXPECT_TRUE(DeleteObject(ring_));
        EXPECT_TRUE(DeleteObject(cross_));
        stage.reset();
        EXPECT_EQ(liveObjects(), start_) << "something was left behind";
    }

    void stamp(HBITMAP bitmap) {
        SpriteStamp(stage->dc, bitmap, &sprite_);
    }

    /// Stands on a clean stage with what lies under him saved.
    void put(HBITMAP bitmap, LONG x, LONG y) {
        stage = std::make_unique<TestSurface>(backdrop);
        sprite_.x = x;
        sprite_.y = y;
        stamp(bitmap);
        SpriteSaveUnder(stage->dc, &sprite_);
        SpriteDraw(stage->dc, &sprite_);
    }

    Rows restored() {
        SpriteRestoreUnder(stage->dc, &sprite_);
        return stage->text();
    }

    seam::HandleCounts start_;
    HBITMAP ring_;
    HBITMAP cross_;
    Sprite sprite_{};
};

} // namespace

// The windows' part of the seam isn't in this program: every window is the stage in memory.
HDC GetDC(HWND /*window*/) {
    return stage->dc;
}

int ReleaseDC(HWND /*window*/, HDC dc) {
    return dc == stage->dc ? 1 : 0;
}

TEST_F(Sprites, StampMakesTheImageAndDrawsNothing) {
    put(ring_, 3, -2);
    const HBITMAP under = sprite_.savedUnder;
    sprite_.drawX = 7;
    stage->touched.clear();
    stamp(cross_);
    EXPECT_EQ(textOf(sprite_.image), cross);
    EXPECT_EQ(sprite_.drawX, 3) << "the draw place goes back to the logical one";
    EXPECT_EQ(sprite_.drawY, -2);
    EXPECT_EQ(sprite_.savedUnder, under);
    EXPECT_TRUE(stage->touched.empty());
}

TEST_F(Sprites, DrawShowsTheStageThroughBlackAndRestorePutsItBack) {
    EXPECT_EQ(restored(), backdrop) << "nothing was saved";
    for (const POINT place : {POINT{2, 2}, POINT{-1, -2}, POINT{6, 4}, POINT{20, 20}}) {
        put(ring_, place.x, place.y);
        EXPECT_EQ(stage->text(), with(ring, place.x, place.y)) << place.x;
        EXPECT_EQ(stage->touched.size(), place.x == 20 ? 0U : 1U) << "one write and no more";
        EXPECT_EQ(restored(), backdrop);
        EXPECT_EQ(restored(), backdrop) << "and may do so again";
    }
    SpriteFree(&sprite_); // comes in with nothing saved
    stamp(cross_);
    SpriteMove(nullptr, &sprite_, 6, 4);
    EXPECT_EQ(stage->text(), with(cross, 6, 4));
    EXPECT_EQ(restored(), backdrop);
}

TEST_F(Sprites, MoveWritesTheNewPlaceThenTheOldAndShowsNothingUnfinished) {
    for (LONG i = 0; i < 9 * 7; ++i) {
        const POINT move{i % 9 - 4, i / 9 - 3};
        SCOPED_TRACE(testing::Message() << move.x << "," << move.y);
        put(ring_, 3, 2);
        const Rows before = stage->text();
        stamp(cross_);
        sprite_.x = 100; // logical and draw place may differ
        SpriteMove(nullptr, &sprite_, 100 + move.x, 2 + move.y);
        const Rows after = with(cross, 3 + move.x, 2 + move.y);
        EXPECT_EQ(stage->text(), after);
        ASSERT_EQ(stage->touched.size(), 3U) << "one write of the drawing, two of the move";
        EXPECT_EQ(stage->touched[2], (RECT{3, 2, 6, 5}));
        for (std::size_t pixel = 0; pixel < 48; ++pixel) {
            const POINT place{static_cast<LONG>(pixel % 8), static_cast<LONG>(pixel / 8)};
            const Rows& expected = PtInRect(&stage->touched[1], place) ? after : before;
            EXPECT_EQ(stage->before[2][pixel / 8][pixel % 8], expected[pixel / 8][pixel % 8]);
        }
        EXPECT_EQ(restored(), backdrop) << "saved at the new place";
    }
}

TEST_F(Sprites, HitTestCountsLeftAndTopEdges) {
    put(ring_, 2, 1);
    EXPECT_TRUE(SpriteHitTest(&sprite_, {2, 1}));
    EXPECT_TRUE(SpriteHitTest(&sprite_, {4, 3}));
    for (const POINT outside : {POINT{5, 1}, POINT{2, 4}, POINT{1, 1}, POINT{2, 0}}) {
        EXPECT_FALSE(SpriteHitTest(&sprite_, outside)) << outside.x << "," << outside.y;
    }
}

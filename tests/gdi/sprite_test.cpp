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

/// The picture with a figure laid over it, as an artist would: the oracle of all that follows.
Rows withFigure(Rows picture, const Rows& figure, int left, int top) {
    for (std::size_t y = 0; y < figure.size(); ++y) {
        for (std::size_t x = 0; x < figure[y].size(); ++x) {
            const int column = left + static_cast<int>(x);
            const int row = top + static_cast<int>(y);
            if (figure[y][x] != '.' && row >= 0 && row < static_cast<int>(picture.size()) &&
                column >= 0 && column < static_cast<int>(picture.front().size())) {
                picture[static_cast<std::size_t>(row)][static_cast<std::size_t>(column)] =
                    figure[y][x];
            }
        }
    }
    return picture;
}

class Sprites : public testing::Test {
  public:
    Sprites(const Sprites&) = delete;
    Sprites& operator=(const Sprites&) = delete;

  protected:
    Sprites() : start_(liveObjects()), ring_(makeBitmap(ring)), cross_(makeBitmap(cross)) {
        stage = std::make_unique<TestSurface>(backdrop);
    }

    ~Sprites() override {
        SpriteFree(&sprite_);
        EXPECT_TRUE(DeleteObject(ring_));
        EXPECT_TRUE(DeleteObject(cross_));
        EXPECT_EQ(liveObjects(), start_) << "something was left behind";
        stage.reset();
    }

    template <class Action>
    static void onStage(Action action) {
        HDC dc = GetDC(nullptr);
        action(dc);
        ReleaseDC(nullptr, dc);
    }

    void stamp(HBITMAP bitmap) {
        onStage([&](HDC dc) { SpriteStamp(dc, bitmap, &sprite_); });
    }

    /// Stands on the stage with what lies under him saved.
    void put(HBITMAP bitmap, LONG x, LONG y) {
        sprite_.x = x;
        sprite_.y = y;
        stamp(bitmap);
        onStage([&](HDC dc) {
            SpriteSaveUnder(dc, &sprite_);
            SpriteDraw(dc, &sprite_);
        });
    }

    seam::HandleCounts start_;
    HBITMAP ring_;
    HBITMAP cross_;
    Sprite sprite_{};
};

} // namespace

// The windows' part of the seam isn't in this program: every window is the stage in memory.
HDC GetDC(HWND /*window*/) {
    const seam::PixelView view = stage->pixels();
    return seam::makeSurfaceContext(*stage, {0, 0, view.width, view.height});
}

int ReleaseDC(HWND /*window*/, HDC dc) {
    return DeleteDC(dc);
}

TEST_F(Sprites, StampMakesTheImageAndDrawsNothing) {
    sprite_.x = 3;
    sprite_.y = -2;
    stamp(ring_);
    EXPECT_EQ(textOf(sprite_.image), ring);
    EXPECT_EQ(sprite_.drawX, 3);
    EXPECT_EQ(sprite_.drawY, -2);
    EXPECT_EQ(sprite_.cx, 3);
    EXPECT_EQ(sprite_.cy, 3);
    EXPECT_FALSE(sprite_.savedUnder);
    EXPECT_TRUE(stage->touched.empty());
    stamp(cross_);
    EXPECT_EQ(textOf(sprite_.image), cross);
}

TEST_F(Sprites, StampTakesTheDrawPlaceBackToTheLogicalOne) {
    put(ring_, 1, 1);
    const HBITMAP under = sprite_.savedUnder;
    sprite_.drawX = 7;
    stamp(ring_);
    EXPECT_EQ(sprite_.drawX, 1);
    EXPECT_EQ(sprite_.savedUnder, under);
}

TEST_F(Sprites, DrawShowsTheStageThroughBlack) {
    for (const POINT place : {POINT{2, 2}, POINT{-1, -2}, POINT{6, 4}, POINT{20, 20}}) {
        stage = std::make_unique<TestSurface>(backdrop);
        put(ring_, place.x, place.y);
        EXPECT_EQ(stage->text(), withFigure(backdrop, ring, place.x, place.y)) << place.x;
        EXPECT_EQ(stage->shown().size(), place.x == 20 ? 1U : 2U) << "one write and no more";
    }
}

TEST_F(Sprites, RestorePutsTheStageBackAndMayDoSoAgain) {
    put(ring_, 6, -1);
    for (int i = 0; i < 2; ++i) {
        onStage([&](HDC dc) { SpriteRestoreUnder(dc, &sprite_); });
        EXPECT_EQ(stage->text(), backdrop);
    }
    EXPECT_TRUE(sprite_.savedUnder);
}

TEST_F(Sprites, RestoreChangesNothingWhereNothingWasSaved) {
    onStage([&](HDC dc) { SpriteRestoreUnder(dc, &sprite_); });
    stamp(ring_);
    onStage([&](HDC dc) { SpriteRestoreUnder(dc, &sprite_); });
    EXPECT_EQ(stage->text(), backdrop);
    EXPECT_TRUE(stage->touched.empty());
}

TEST_F(Sprites, SaveUnderKeepsWhatStandsThere) {
    put(ring_, 2, 2);
    onStage([&](HDC dc) { SpriteSaveUnder(dc, &sprite_); });
    EXPECT_EQ(textOf(sprite_.savedUnder), (Rows{"BRB", "RYR", "BRB"}));
}

TEST_F(Sprites, MoveShowsTheNewPictureAndTheCleanStage) {
    for (LONG dy = -4; dy <= 4; ++dy) {
        for (LONG dx = -4; dx <= 4; ++dx) {
            stage = std::make_unique<TestSurface>(backdrop);
            put(ring_, 3, 2);
            stamp(cross_);
            SpriteMove(nullptr, &sprite_, 3 + dx, 2 + dy);
            EXPECT_EQ(stage->text(), withFigure(backdrop, cross, 3 + dx, 2 + dy))
                << dx << "," << dy;
            EXPECT_EQ(sprite_.x, 3 + dx);
            EXPECT_EQ(sprite_.drawY, 2 + dy);
            onStage([&](HDC dc) { SpriteRestoreUnder(dc, &sprite_); });
            EXPECT_EQ(stage->text(), backdrop) << "saved at the new place: " << dx << "," << dy;
        }
    }
}

TEST_F(Sprites, MoveChangesThePictureInPlace) {
    put(ring_, 3, 2);
    stamp(cross_);
    SpriteMove(nullptr, &sprite_, 3, 2);
    EXPECT_EQ(stage->text(), withFigure(backdrop, cross, 3, 2));
}

TEST_F(Sprites, MoveNeverShowsAnythingUnfinished) {
    const auto isFigurePixel = [](char pixel) { return pixel == 'R' || pixel == 'M'; };
    for (LONG dx = -4; dx <= 4; ++dx) {
        stage = std::make_unique<TestSurface>(backdrop);
        put(ring_, 3, 2);
        const Rows before = stage->text();
        stamp(cross_);
        SpriteMove(nullptr, &sprite_, 3 + dx, 3);
        const Rows after = stage->text();
        for (const Rows& picture : stage->shown()) {
            for (std::size_t y = 0; y < picture.size() && picture != backdrop; ++y) {
                for (std::size_t x = 0; x < picture[y].size(); ++x) {
                    const char pixel = picture[y][x];
                    EXPECT_TRUE(pixel == before[y][x] || pixel == after[y][x]) << dx;
                    if (isFigurePixel(before[y][x]) && isFigurePixel(after[y][x])) {
                        EXPECT_TRUE(isFigurePixel(pixel)) << "the bare backdrop showed: " << dx;
                    }
                }
            }
        }
        EXPECT_EQ(stage->touched.size(), 3U) << "one write of the drawing, two of the move";
    }
}

TEST_F(Sprites, MoveWritesTheNewPlaceFirstAndNothingElse) {
    put(ring_, 1, 1);
    stage->touched.clear();
    SpriteMove(nullptr, &sprite_, 2, 1);
    EXPECT_EQ(stage->touched, (std::vector<RECT>{{2, 1, 5, 4}, {1, 1, 4, 4}}));
}

TEST_F(Sprites, AWalkAcrossTheStageLeavesNoTrace) {
    sprite_.x = -4;
    sprite_.y = 1;
    stamp(ring_); // parked outside, and nothing saved
    for (LONG x = -3; x <= 9; ++x) {
        const bool odd = x % 2 != 0;
        stamp(odd ? cross_ : ring_);
        SpriteMove(nullptr, &sprite_, x, x / 3);
        EXPECT_EQ(stage->text(), withFigure(backdrop, odd ? cross : ring, x, x / 3)) << x;
    }
    EXPECT_EQ(stage->text(), backdrop);
    for (LONG x = 8; x >= -4; --x) {
        stamp(ring_);
        SpriteMove(nullptr, &sprite_, x, 2);
        EXPECT_EQ(stage->text(), withFigure(backdrop, ring, x, 2)) << x;
    }
    EXPECT_EQ(stage->text(), backdrop);
}

TEST_F(Sprites, MoveInFromAnySideWithNothingSaved) {
    const struct {
        POINT from, to;
    } cases[] = {{{-3, 2}, {-1, 2}}, {{8, 2}, {6, 2}}, {{3, -3}, {3, -1}}, {{3, 6}, {3, 4}}};

    for (const auto& c : cases) {
        SpriteFree(&sprite_);
        stage = std::make_unique<TestSurface>(backdrop);
        sprite_.x = c.from.x;
        sprite_.y = c.from.y;
        stamp(cross_);
        SpriteMove(nullptr, &sprite_, c.to.x, c.to.y);
        EXPECT_EQ(stage->text(), withFigure(backdrop, cross, c.to.x, c.to.y)) << c.from.x;
        onStage([&](HDC dc) { SpriteRestoreUnder(dc, &sprite_); });
        EXPECT_EQ(stage->text(), backdrop);
    }
}

TEST_F(Sprites, MoveGoesByTheDifferenceFromWhereverTheSpriteStands) {
    put(ring_, 2, 2);
    sprite_.x = 100; // logical and draw place may differ
    sprite_.y = 200;
    SpriteMove(nullptr, &sprite_, 101, 199);
    EXPECT_EQ(sprite_.x, 101);
    EXPECT_EQ(sprite_.y, 199);
    EXPECT_EQ(sprite_.drawX, 3);
    EXPECT_EQ(sprite_.drawY, 1);
    EXPECT_EQ(stage->text(), withFigure(backdrop, ring, 3, 1));
}

TEST_F(Sprites, ImageAndSavedUnderAreFreeBetweenCalls) {
    put(ring_, 2, 2);
    SpriteMove(nullptr, &sprite_, 3, 3);
    HDC dc = CreateCompatibleDC(nullptr);
    const HGDIOBJ before = SelectObject(dc, sprite_.image);
    EXPECT_TRUE(before);
    EXPECT_TRUE(SelectObject(dc, sprite_.savedUnder));
    SelectObject(dc, before);
    DeleteDC(dc);
    auto expected = start_;
    expected.gdiObjects += 4; // two bitmaps of this test, image and savedUnder
    EXPECT_EQ(liveObjects(), expected);
}

TEST_F(Sprites, HitTestCountsLeftAndTopEdges) {
    put(ring_, 2, 1);

    const struct {
        POINT point;
        bool hit;
    } cases[] = {{{2, 1}, true},  {{4, 3}, true},  {{5, 1}, false}, {{2, 4}, false},
                 {{5, 4}, false}, {{1, 1}, false}, {{2, 0}, false}};

    for (const auto& c : cases) {
        EXPECT_EQ(SpriteHitTest(&sprite_, c.point) != 0, c.hit) << c.point.x << "," << c.point.y;
    }
}

TEST_F(Sprites, FreeForgetsAllAndMayComeTwice) {
    put(ring_, 2, 1);
    sprite_.frameBitmap = ring_;
    SpriteFree(&sprite_);
    SpriteFree(&sprite_);
    EXPECT_FALSE(sprite_.frameBitmap);
    EXPECT_FALSE(sprite_.image);
    EXPECT_FALSE(sprite_.savedUnder);
    EXPECT_EQ(textOf(ring_), ring) << "the borrowed bitmap lives";
}

TEST_F(Sprites, StampOnceLeavesNothingButThePicture) {
    const auto before = liveObjects();
    onStage([&](HDC dc) { SpriteStampOnce(dc, cross_, 5, 4); });
    EXPECT_EQ(stage->text(), withFigure(backdrop, cross, 5, 4));
    EXPECT_EQ(liveObjects(), before);
}

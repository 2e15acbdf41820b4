#include "stage/character.h"

#include "platform/kernel.h"
#include "stage/bubble.h"
#include "tests/stage/stage_fixture.h"

#include <algorithm>
#include <iterator>

namespace {

class Character : public StageTest {};

} // namespace

TEST_F(Character, HasTwentyEightPicturesOfOneSize) {
    for (const HBITMAP picture : CharacterArt) {
        const seam::Picture drawn = seam::bitmapPicture(picture);
        EXPECT_EQ(drawn.width, 130) << CharacterArtName(picture);
        EXPECT_EQ(drawn.height, 130) << CharacterArtName(picture);
        EXPECT_EQ(drawn.pixels.front() & 0xFFFFFF, 0U) << CharacterArtName(picture);
    }
    EXPECT_STREQ(CharacterArtName(CharacterArt[0]), "fdl2r1");
    EXPECT_STREQ(CharacterArtName(CharacterArt[15]), "fdr2l8");
    EXPECT_STREQ(CharacterArtName(CharacterArt[18]), "fdrtn1");
    EXPECT_STREQ(CharacterArtName(CharacterArt[27]), "pose08");
    EXPECT_STREQ(CharacterArtName(nullptr), "none");
    EXPECT_EQ(BubbleSprite.cx, 160);
    EXPECT_EQ(BubbleSprite.cy, 95);
}

TEST_F(Character, ASecondLoadLeaksNothing) {
    const seam::HandleCounts before = seam::liveHandles();
    EXPECT_EQ(LoadCharacterArt(stage, GetModuleHandleA(nullptr)), 1);
    EXPECT_TRUE(seam::liveHandles() == before);
}

TEST_F(Character, ReleasedLeavesEmptySlots) {
    BubbleHidden = 0;
    EXPECT_EQ(ReleaseStageArt(), 0);
    EXPECT_EQ(CharacterArtLoaded, 0U);
    EXPECT_EQ(BubbleHidden, 1U);
    EXPECT_EQ(std::count(std::begin(CharacterArt), std::end(CharacterArt), HBITMAP{}), 28);
    EXPECT_FALSE(CharacterSprite.image || CharacterSprite.frameBitmap || BubbleSprite.image);
}

TEST_F(Character, ParksOffTheStageAtHalfItsHeightRoundedDown) {
    openStage(640, 701);
    CharacterSprite.frameBitmap = CharacterArt[25];
    EXPECT_EQ(ResetCharacter(stage), 1);
    EXPECT_EQ(CharacterSprite.drawX, -150);
    EXPECT_EQ(CharacterSprite.drawY, 350);
    EXPECT_EQ(CharacterSprite.cx, 130);
    EXPECT_EQ(CharacterSprite.frameBitmap, CharacterArt[0]);
}

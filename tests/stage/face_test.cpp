#include "stage/face.h"

#include "stage/character.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "tests/stage/stage_fixture.h"

#include <limits>

using testing::ElementsAre;

namespace {

class Face : public StageTest {
  protected:
    void SetUp() override {
        StageTest::SetUp();
        CharacterSprite.drawX = 400;
        CharacterSprite.drawY = 300;
        PlayFrame = frame(0, 0, 3, 0, 1, "");
    }

    /// Ticks until the talk has ended by itself, at most `most`.
    int talkFor(const char* text, int most) const {
        CopyText(PlayFrame.text, text, sizeof(PlayFrame.text));
        StartTalking(stage);
        int ticks = 0;
        for (; Talking != 0 && ticks < most; ++ticks) {
            TalkTick(stage);
        }
        StopTalking(stage);
        return ticks;
    }
};

} // namespace

TEST_F(Face, CopiesTheCellOfItsPoseOntoTheScreen) {
    EXPECT_EQ(ShowExpression(stage, 4), 1);
    EXPECT_THAT(events({"face"}), ElementsAre("face expr=4 src=[33,33] dst=[455,334]"));
    const seam::Picture sheet = seam::bitmapPicture(ExpressionSheet);
    std::vector<DWORD> cell;
    for (int y = 33; y < 43; ++y) {
        for (int x = 33; x < 43; ++x) {
            const int place = y * sheet.width + x;
            cell.push_back(sheet.pixels[static_cast<std::size_t>(place)] & 0xFFFFFF);
        }
    }
    EXPECT_EQ(pixels({455, 334, 465, 344}), cell);
}

TEST_F(Face, PutsEyesAndMouthWhereThePoseHasThem) {
    const LONG places[8][4] = {{453, 317, 457, 332}, {458, 314, 462, 334}, {456, 316, 456, 332},
                               {459, 314, 455, 334}, {455, 315, 455, 332}, {463, 316, 459, 331},
                               {457, 317, 460, 332}, {464, 315, 464, 331}};
    constexpr LONG lowest = std::numeric_limits<LONG>::min();
    const LONG poses[][2] = {{lowest, 0}, {-1, 0}, {0, 0}, {1, 1}, {2, 2}, {3, 3},
                             {4, 4},      {5, 5},  {6, 6}, {7, 7}, {8, 7}, {999, 7}};
    for (const auto& pose : poses) {
        PlayFrame.pose = pose[0];
        Record.clear();
        ShowExpression(stage, EXPRESSION_EYES_OPEN);
        ShowExpression(stage, EXPRESSION_MOUTH_FIRST);
        const LONG* place = places[pose[1]];
        const std::string row = std::to_string(pose[1] * 11);
        const auto at = [](LONG x, LONG y) {
            return "dst=[" + std::to_string(x) + "," + std::to_string(y) + "]";
        };
        EXPECT_THAT(events({"face"}),
                    ElementsAre("face expr=2 src=[11," + row + "] " + at(place[0], place[1]),
                                "face expr=3 src=[22," + row + "] " + at(place[2], place[3])));
    }
}

TEST_F(Face, BlinksOnlyForAFrameThatWinks) {
    PlayFrame.wink = 0;
    EXPECT_EQ(ShowExpression(stage, EXPRESSION_EYES_SHUT), 0);
    EXPECT_EQ(ShowExpression(stage, EXPRESSION_EYES_OPEN), 0);
    EXPECT_EQ(ShowExpression(stage, EXPRESSION_MOUTH_FIRST), 1);
    PlayFrame.wink = -4;
    EXPECT_EQ(ShowExpression(stage, EXPRESSION_EYES_SHUT), 1);
    EXPECT_EQ(StampFaceCell(stage, 0, 0, 0), 0);
}

TEST_F(Face, FollowsTheRandomWalkWhileThereIsOne) {
    PlayFrame.wink = 0;
    WalkFrame = frame(0, 0, 5, 0, 1, "");
    for (const DWORD walking : {1U, 0U}) {
        RandomWalkActive = walking;
        ShowExpression(stage, EXPRESSION_EYES_OPEN);
        ShowExpression(stage, EXPRESSION_MOUTH_FIRST);
    }
    EXPECT_THAT(events({"face"}), ElementsAre("face expr=2 src=[11,55] dst=[463,316]",
                                              "face expr=3 src=[22,55] dst=[459,331]",
                                              "face expr=3 src=[22,33] dst=[455,334]"));
}

TEST_F(Face, TalksAQuarterOfItsLettersInTicks) {
    const struct {
        const char* text;
        int ticks;
    } cases[] = {{"12345", 1},
                 {"12345678", 1},
                 {"123456789", 2},
                 {"1", 50},
                 {"1234", 50}, // no end of its own
                 {"", 0},
                 {"123456789-123456789-123456789-123456789-123456789-123456789-123456789", 17}};

    for (const auto& one : cases) {
        EXPECT_EQ(talkFor(one.text, 50), one.ticks) << one.text;
    }
}

TEST_F(Face, NeverShowsTheSameMouthTwiceAndClosesItAtTheEnd) {
    talkFor("123456789-123456789-123456789-123456789-123456789-123456789-123456789", 50);
    const std::vector<std::string> mouths = events({"face"});
    ASSERT_EQ(mouths.size(), 17U);
    EXPECT_THAT(mouths.back(), testing::StartsWith("face expr=5"));
    for (std::size_t tick = 1; tick + 1 < mouths.size(); ++tick) {
        EXPECT_NE(mouths[tick], mouths[tick - 1]);
    }
}

TEST_F(Face, ATalkUnderWayIsNotStartedAnew) {
    CopyText(PlayFrame.text, "Long enough", sizeof(PlayFrame.text));
    EXPECT_EQ(StartTalking(stage), 1);
    TalkTick(stage);
    EXPECT_EQ(StartTalking(stage), 0);
    EXPECT_EQ(TalkTicks, 1);
    StopTalking(stage);
    StopTalking(stage);
    EXPECT_EQ(count("talk_stop"), 1);
    EXPECT_EQ(seam::liveHandles().timers, 0U);
}

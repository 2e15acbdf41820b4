// The Toons that come with the program, as somebody sees them who watches.
#include "stage/bubble.h"
#include "stage/player.h"
#include "stage/walk.h"
#include "tests/stage/stage_fixture.h"

#include <cstdio>
#include <set>

namespace {

class ShippedToons : public StageTest {
  protected:
    void SetUp() override {
        StageTest::SetUp();
        for (const auto& entry : std::filesystem::directory_iterator(DORBO_SOURCE_DIR "/toons")) {
            if (entry.path().extension() == ".json") {
                names.insert(entry.path().stem().string() + ".zkt");
            }
        }
    }

    std::vector<ToonFrame> open(const std::string& name) const {
        std::filesystem::current_path(DORBO_TOONS);
        EXPECT_EQ(ToonOpenNamed(stage, name.c_str()), 1) << name;
        std::vector<ToonFrame> frames(static_cast<std::size_t>(FrameCount));
        for (LONG index = 0; index < FrameCount; ++index) {
            FrameGet(index, &frames[static_cast<std::size_t>(index)]);
        }
        return frames;
    }

    /// Where he stood at the end of each walk of the show that was acted out.
    static std::vector<POINT> places() {
        std::vector<POINT> found;
        POINT at = {};
        for (const std::string& line : events({"draw", "walk_done"})) {
            if (line == "walk_done") {
                found.push_back(at);
            } else {
                std::sscanf(line.c_str(), "draw i=%*d bitmap=%*s at=[%d,%d]", &at.x, &at.y);
            }
        }
        return found;
    }

    /// That a bubble of the record lies on the stage.
    static void expectWhole(const std::string& bubble, const SIZE& size) {
        RECT area = {-1, -1, 0, 0};
        std::sscanf(bubble.c_str(), "bubble_show rect=[%d,%d,%d,%d]", &area.left, &area.top,
                    &area.right, &area.bottom);
        EXPECT_TRUE(area.left >= 0 && area.top >= 0 && area.right <= size.cx &&
                    area.bottom <= size.cy)
            << bubble;
    }

    std::set<std::string> names;
};

/// How much of him is to be seen along one axis, of 130 pixels.
LONG seen(LONG at, LONG length) {
    return std::max<LONG>(0, std::min(at + CharacterSprite.cx, length) - std::max<LONG>(at, 0));
}

} // namespace

TEST_F(ShippedToons, AreEightOnTilesOfTheirOwnAtEverySpeedInEveryPose) {
    std::set<LONG> tiles, speeds, poses;
    for (const std::string& name : names) {
        const std::vector<ToonFrame> frames = open(name);
        EXPECT_THAT(frames.size(), testing::AllOf(testing::Ge(4U), testing::Le(12U))) << name;
        tiles.insert(BackgroundIndex);
        speeds.insert(ToonSpeed);
        for (const ToonFrame& frame : frames) {
            poses.insert(frame.pose);
        }
    }
    EXPECT_EQ(tiles.size(), 8U);
    EXPECT_EQ(names.size(), 8U);
    EXPECT_EQ(speeds.size(), 5U);
    EXPECT_EQ(poses.size(), 8U);
}

TEST_F(ShippedToons, SayWhatFitsTheBubbleInLinesThatBreakWhereTheyMeanTo) {
    constexpr int body = 71; // pixels of the bubble's height for text
    PlaceBubble(stage);
    const int line = DrawBubbleText(stage, "Hello");
    ASSERT_GT(line, 0);
    EXPECT_GT(DrawBubbleText(stage, "A line that is too long for him"), line);
    for (const std::string& name : names) {
        for (const ToonFrame& frame : open(name)) {
            const std::string text = frame.text;
            const auto lines = static_cast<int>(1 + std::count(text.begin(), text.end(), '\r'));
            EXPECT_TRUE(text.empty() || DrawBubbleText(stage, frame.text) == lines * line) << text;
            EXPECT_LE(lines * line, body) << text;
        }
    }
}

TEST_F(ShippedToons, ShowHimAndHisBubbleWhollyWhileHeSpeaksAndElseWhollyOrNotAtAll) {
    const SIZE stages[] = {{640, 480}, {1024, 768}, {1920, 1080}};
    for (const SIZE& size : stages) {
        openStage(size.cx, size.cy);
        for (const std::string& name : names) {
            SCOPED_TRACE(name + " on " + std::to_string(size.cx) + "x" + std::to_string(size.cy));
            const std::vector<ToonFrame> frames = open(name);
            PlayNextFrame(stage);
            EXPECT_TRUE(runUntilEvent("walk_off"));
            const std::vector<POINT> stood = places();
            ASSERT_EQ(stood.size(), frames.size());
            for (std::size_t i = 0; i < frames.size(); ++i) {
                const LONG across = seen(stood[i].x, size.cx);
                const LONG down = seen(stood[i].y, size.cy);
                const bool wholly = across == CharacterSprite.cx && down == CharacterSprite.cy;
                const bool silent = frames[i].text[0] == '\0';
                EXPECT_TRUE(wholly || (silent && across * down == 0)) << "frame " << i + 1;
            }
            for (const std::string& bubble : events({"bubble_show"})) {
                expectWhole(bubble, size);
            }
            EXPECT_TRUE(runUntilEvent("walk_done"));
            EXPECT_EQ(seen(CharacterSprite.drawX, size.cx), 0) << "he is still there at the end";
            ResetShow(stage);
        }
    }
}

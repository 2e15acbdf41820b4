// Recorded shows: each Toon on three sizes of stage, runs of the saver's cycle, and scenes of the
// editor, acted out again on a clock moved by hand and held line by line against the record.
//
// With DORBO_RECORD=1 in its environment the test writes the records anew; what changed in them is
// then to be read before it is kept.
#include "cli/replay.h"

#include "platform/harness.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>

#include <gtest/gtest.h>

namespace {

namespace fs = std::filesystem;

const fs::path here = DORBO_SOURCE_DIR "/tests/replay";
const fs::path shipped = DORBO_TOONS;
const fs::path odd = DORBO_ODD_TOONS;

using Lines = std::vector<std::string>;

Lines replay(const ReplayOptions& options) {
    // What is made once and kept has been made by the end of the first one. The saver leaves its
    // backdrop to the next stage, the editor doesn't.
    static std::map<ReplayMode, seam::HandleCounts> baselines;
    if (!baselines.contains(options.mode)) {
        Replay(options, {[](const std::string&) {}});
        baselines[options.mode] = seam::liveHandles();
    }
    Lines lines;
    Replay(options, {[&](const std::string& line) { lines.push_back(line); }});
    EXPECT_EQ(seam::liveHandles(), baselines[options.mode]) << "a handle or timer was left behind";
    return lines;
}

Lines readLines(const fs::path& file) {
    std::ifstream in(file);
    Lines lines;
    for (std::string line; std::getline(in, line);) {
        lines.push_back(line);
    }
    return lines;
}

void holdAgainstRecord(const ReplayOptions& options, const std::string& name) {
    const Lines now = replay(options);
    const fs::path file = here / "traces" / (name + ".trace");
    if (std::getenv("DORBO_RECORD") != nullptr) {
        std::ofstream out(file);
        for (const std::string& line : now) {
            out << line << '\n';
        }
    }
    const Lines recorded = readLines(file);
    for (std::size_t i = 0; i < std::min(now.size(), recorded.size()); ++i) {
        ASSERT_EQ(now[i], recorded[i]) << name << ", line " << i + 1;
    }
    EXPECT_EQ(now.size(), recorded.size()) << name;
}

/// The Toon file of a name: one of those that come with the program, or of those in toons/ here.
fs::path toonFile(const std::string& name) {
    const std::string file = name + ".zkt";
    return fs::exists(odd / file) ? odd / file : shipped / file;
}

class Toon : public testing::TestWithParam<const char*> {};

TEST_P(Toon, RunsAsRecordedOnThreeStages) {
    const fs::path file = toonFile(GetParam());
    const SIZE stages[] = {{640, 480}, {1024, 768}, {1601, 901}};
    for (const SIZE& stage : stages) {
        ReplayOptions options;
        options.toons = {file};
        options.width = stage.cx;
        options.height = stage.cy;
        holdAgainstRecord(options, std::string(GetParam()) + "-" + std::to_string(stage.cx) + "x" +
                                       std::to_string(stage.cy));
    }
}

INSTANTIATE_TEST_SUITE_P(Shipped, Toon, testing::Values("intro", "lost-thought", "shortest-way"));
// one-frame: he comes in, stands without a word or a wink, goes off.
// on-the-spot: twice the same place, so that the second walk is one stride; a speed, poses and a
//     background beyond their range, texts too short to talk in time.
// no-pause: a frame that was never filled in; the show stands there for good.
// half-a-stage: only the height was recorded, and only that axis is scaled.
// far-away: a walk of more strides than the table holds, and back.
INSTANTIATE_TEST_SUITE_P(Odd, Toon,
                         testing::Values("one-frame", "on-the-spot", "no-pause", "half-a-stage",
                                         "far-away"));

TEST(WalkAbout, RunsAsRecordedWithStatementsAndWithout) {
    ReplayOptions options;
    options.shows = 4;
    options.paces = 4711;
    holdAgainstRecord(options, "walk-about");
    options.statements = false;
    holdAgainstRecord(options, "walk-about-silent");
}

TEST(Cycle, RunsAsRecorded) {
    ReplayOptions options;
    for (const char* name : {"intro", "lost-thought", "shortest-way"}) {
        options.toons.push_back(toonFile(name));
    }
    options.seed = 5;
    options.shows = 4;
    holdAgainstRecord(options, "cycle-of-three");
}

TEST(Player, PlaysOneToonOrWalksAboutOnceAsRecorded) {
    ReplayOptions options;
    options.mode = ReplayMode::player;
    options.shows = 3; // there is never a second one
    options.statements = false;
    holdAgainstRecord(options, "player-walk-about");
    options.toons = {toonFile("one-frame")};
    holdAgainstRecord(options, "player-one-frame");
}

ReplayOptions sceneOptions(const std::string& name) {
    ReplayOptions options;
    options.mode = ReplayMode::editor;
    for (const char* toon : {"there-and-back", "no-pause", "one-frame"}) {
        options.toons.push_back(toonFile(toon));
    }
    std::ifstream in(here / "scenes" / (name + ".scene"));
    EXPECT_TRUE(in) << name;
    options.scene = ReadScene(in, name);
    return options;
}

class Scene : public testing::TestWithParam<const char*> {};

TEST_P(Scene, RunsAsRecorded) {
    holdAgainstRecord(sceneOptions(GetParam()), std::string("editor-") + GetParam());
}

INSTANTIATE_TEST_SUITE_P(Editor, Scene,
                         testing::Values("early", "opening", "show", "stops", "other-window",
                                         "another-toon", "no-pause", "new-toon", "frame-editor"));

TEST(Editor, ClosedAtAnyMomentItBeginsAnewAsInAFreshProcess) {
    const Lines show = readLines(here / "traces/editor-show.trace");
    const Lines opening = readLines(here / "traces/editor-opening.trace");
    for (const char* name : {"opening", "stops", "another-toon", "no-pause"}) {
        for (const std::int64_t moment : {600, 1100, 1700, 3000, 5800, 8500, 10000, 14000, 29000}) {
            ReplayOptions cut = sceneOptions(name);
            std::erase_if(cut.scene, [&](const SceneStep& step) { return step.moment > moment; });
            std::istringstream in(std::to_string(moment) + " close");
            cut.scene.push_back(ReadScene(in, "close").front());
            replay(cut);
            ASSERT_EQ(replay(sceneOptions("show")), show) << name << " closed at " << moment;
            replay(cut);
            ASSERT_EQ(replay(sceneOptions("opening")), opening) << name << ", " << moment;
        }
    }
}

TEST(Editor, ALineOfASceneThatIsNoneIsNamed) {
    const std::pair<const char*, const char*> cases[] = {
        {"5 play\n\n# a word\n4 play", "a:4: the moment 4 comes before that of the line above"},
        {"soon play", "a:1: soon is no number that fits here"},
        {"5", "a:1: there is no action"},
        {"5 jump", "a:1: jump is no action of a scene"},
        {"5 click 3", "a:1: click takes 2 arguments, not 1"},
        {"5 click 3 40000", "a:1: 40000 is no number that fits here"},
        {"5 command 122", "a:1: what command 122 opens can't be answered"},
    };
    for (const auto& [text, wrong] : cases) {
        std::istringstream in(text);
        try {
            ReadScene(in, "a");
            ADD_FAILURE() << text;
        } catch (const std::runtime_error& error) {
            EXPECT_STREQ(error.what(), wrong);
        }
    }
}

/// The lines with these words, without their times.
Lines linesWith(const Lines& lines, const std::string& words) {
    Lines found;
    for (const std::string& line : lines) {
        if (line.find(words) != std::string::npos) {
            found.push_back(line.substr(line.find(' ') + 1));
        }
    }
    return found;
}

TEST(Cycle, StandsStillAfterAToonThatDoesNotLoad) {
    ReplayOptions options;
    options.toons = {DORBO_SOURCE_DIR "/tests/toon/bad/version-of-tomorrow.zkt"};
    const Lines lines = replay(options);
    EXPECT_EQ(linesWith(lines, " message ").size(), 1U);
    EXPECT_EQ(linesWith(lines, " tick "), Lines{"tick timer=SHOWSTART"});
    EXPECT_EQ(linesWith(lines, " end "), Lines{"end odometer=0 shows=0"});
}

} // namespace

// Recorded shows: each Toon on three sizes of stage, and runs of the saver's cycle, acted out again
// on a clock moved by hand and held line by line against the record.
//
// With DORBO_RECORD=1 in its environment the test writes the records anew; what changed in them is
// then to be read before it is kept.
#include "cli/make_print.h"
#include "cli/replay.h"

#include "platform/harness.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <set>

#include <gtest/gtest.h>

namespace {

namespace fs = std::filesystem;

const fs::path here = DORBO_SOURCE_DIR "/tests/replay";
const fs::path shipped = DORBO_SOURCE_DIR "/toons";

using Lines = std::vector<std::string>;

Lines replay(const ReplayOptions& options) {
    Lines lines;
    Replay(options, [&](const std::string& line) { lines.push_back(line); });
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

/// A directory for the Toons that are made here.
class Workshop {
  public:
    Workshop() {
        std::string pattern = fs::temp_directory_path() / "replay-test-XXXXXX";
        path_ = mkdtemp(pattern.data());
    }

    Workshop(const Workshop&) = delete;
    Workshop& operator=(const Workshop&) = delete;

    ~Workshop() {
        std::error_code ignored;
        fs::remove_all(path_, ignored);
    }

    const fs::path& path() const {
        return path_;
    }

  private:
    fs::path path_;
};

/// The Toon file of a name: one of those that come with the program, or made from the text here.
fs::path toonFile(const std::string& name) {
    const fs::path text = here / "toons" / (name + ".txt");
    if (!fs::exists(text)) {
        return shipped / (name + ".zkt");
    }
    static const Workshop workshop;
    fs::path made = workshop.path() / (name + ".zkt");
    EXPECT_EQ(MakeCommand({text, made}), 0);
    return made;
}

struct Stage {
    int width;
    int height;
};

constexpr Stage stages[] = {{640, 480}, {1024, 768}, {1601, 901}};

class Toon : public testing::TestWithParam<const char*> {};

TEST_P(Toon, RunsAsRecordedOnThreeStages) {
    const fs::path file = toonFile(GetParam());
    for (const Stage& stage : stages) {
        ReplayOptions options;
        options.toons = {file};
        options.width = stage.width;
        options.height = stage.height;
        holdAgainstRecord(options, std::string(GetParam()) + "-" + std::to_string(stage.width) +
                                       "x" + std::to_string(stage.height));
    }
}

INSTANTIATE_TEST_SUITE_P(Shipped, Toon, testing::Values("intro", "lost-thought", "shortest-way"));
INSTANTIATE_TEST_SUITE_P(Odd, Toon,
                         testing::Values("one-frame", "on-the-spot", "no-pause", "no-stage",
                                         "half-a-stage", "far-away"));

ReplayOptions cycleOfThree(std::uint32_t seed, int shows) {
    ReplayOptions options;
    for (const char* name : {"intro", "lost-thought", "shortest-way"}) {
        options.toons.push_back(toonFile(name));
    }
    options.seed = seed;
    options.shows = shows;
    return options;
}

/// The values of `key` in all lines of an event.
Lines valuesOf(const Lines& lines, const std::string& event, const std::string& key) {
    Lines values;
    for (const std::string& line : lines) {
        const auto at = line.find(key + "=");
        if (line.find(" " + event + " ") != std::string::npos && at != std::string::npos) {
            const auto from = at + key.size() + 1;
            values.push_back(line.substr(from, line.find(' ', from) - from));
        }
    }
    return values;
}

ReplayOptions walksAbout(bool statements) {
    ReplayOptions options;
    options.statements = statements;
    options.shows = 4;
    options.paces = 4711;
    return options;
}

TEST(WalkAbout, RunsAsRecordedWithStatementsAndWithout) {
    holdAgainstRecord(walksAbout(true), "walk-about");
    holdAgainstRecord(walksAbout(false), "walk-about-silent");
}

TEST(Cycle, RunsAsRecorded) {
    holdAgainstRecord(cycleOfThree(5, 4), "cycle-of-three");
}

TEST(Cycle, PlaysTheIntroFirstAndNeverTheSameTwiceInARow) {
    constexpr int shows = 40;
    for (const std::uint32_t seed : {1U, 2U, 3U}) {
        const Lines played = valuesOf(replay(cycleOfThree(seed, shows)), "load", "file");
        ASSERT_EQ(played.size(), static_cast<std::size_t>(shows));
        EXPECT_EQ(played.front(), "intro.zkt");
        for (std::size_t i = 1; i < played.size(); ++i) {
            EXPECT_NE(played[i], played[i - 1]) << "show " << i;
        }
        EXPECT_EQ(std::set<std::string>(played.begin(), played.end()).size(), 3U);
    }
}

TEST(Cycle, GivesTheIntroNoPreferenceOnceHeHasWalked) {
    Lines first;
    for (std::uint32_t seed = 1; seed <= 12; ++seed) {
        ReplayOptions options = cycleOfThree(seed, 1);
        options.paces = 1;
        first.push_back(valuesOf(replay(options), "load", "file").front());
    }
    EXPECT_GT(std::count_if(first.begin(), first.end(),
                            [](const std::string& name) { return name != "intro.zkt"; }),
              0);
}

TEST(Cycle, PlaysASingleToonOverAndOver) {
    ReplayOptions options;
    options.toons = {toonFile("one-frame")};
    options.shows = 3;
    EXPECT_EQ(valuesOf(replay(options), "load", "file"), Lines(3, "one-frame.zkt"));
}

TEST(Cycle, StandsStillAfterAToonThatDoesNotLoad) {
    ReplayOptions options;
    options.toons = {DORBO_SOURCE_DIR "/tests/toon/bad/version-of-tomorrow.zkt"};
    const Lines lines = replay(options);
    EXPECT_EQ(valuesOf(lines, "message", "text"), Lines{"Invalid"});
    EXPECT_EQ(valuesOf(lines, "end", "shows"), Lines{"0"});
    EXPECT_TRUE(valuesOf(lines, "tick", "timer") == Lines{"SHOWSTART"});
}

/// The counts of live handles once what is made once and kept has been made.
seam::HandleCounts baseline() {
    replay(cycleOfThree(1, 1));
    return seam::liveHandles();
}

TEST(Cycle, LeavesNoHandleBehind) {
    const seam::HandleCounts before = baseline();
    replay(cycleOfThree(2, 3));
    EXPECT_EQ(seam::liveHandles(), before);
}

TEST(Cycle, StaysHealthyWhateverTheToonHolds) {
    const seam::HandleCounts before = baseline();
    int played = 0;
    for (const auto& entry : fs::directory_iterator(DORBO_SOURCE_DIR "/tests/toon/bad")) {
        ReplayOptions options;
        options.toons = {entry.path()};
        options.longest = 60'000; // a pause can be longer than anybody waits
        const Lines lines = replay(options);
        // It plays to its end or, behind its box or a frame without a pause, stands still; the
        // saver closes as ever.
        EXPECT_EQ(valuesOf(lines, "choice", "file").front(), entry.path().filename());
        EXPECT_NE(std::find_if(lines.begin(), lines.end(),
                               [](const std::string& line) {
                                   return line.find(" close") != std::string::npos;
                               }),
                  lines.end())
            << entry.path();
        EXPECT_EQ(seam::liveHandles(), before) << entry.path();
        ++played;
    }
    EXPECT_GE(played, 15);
}

TEST(Cycle, ComesOutTheSameForTheSameSeed) {
    EXPECT_EQ(replay(cycleOfThree(7, 3)), replay(cycleOfThree(7, 3)));
}

} // namespace

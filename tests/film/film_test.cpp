// Films that the program makes, held against the stage itself.
#include "cli/replay.h"
#include "tests/film/film_readers.h"
#include "tests/kernel/scratch_directory.h"
#include "toon/toon_document.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace {

using test::Film;
using test::Shown;
using testing::HasSubstr;
namespace fs = std::filesystem;

/// A Toon made on a stage of 320 x 240: he speaks, winks, and goes.
std::string toon(std::vector<ToonFrame> frames) {
    ToonHeader header{"Dorbo Toon Frame File", TOON_VERSION, "A short one", 0, 0, 5, 4};
    header.windowSize = MAKELONG(320, 240);
    std::string bytes(reinterpret_cast<const char*>(&header), sizeof header);
    return bytes.append(reinterpret_cast<const char*>(frames.data()),
                        frames.size() * sizeof(ToonFrame));
}

const std::string shortToon =
    toon({{60, 120, 2, 2, 0, "Hello,\rfilm!", 0}, {200, 130, 5, 1, 1, "", 0}});
const std::string standsForGood = toon({{60, 120, 2, 0, 0, "", 0}});

/// What stands on the stage at each moment at which something happens.
struct Stood {
    std::vector<Shown> pictures;
    std::int64_t end;
};

Stood watchStage(const ReplayOptions& options) {
    Stood stood;
    const auto look = [&](std::vector<DWORD> pixels) {
        for (DWORD& pixel : pixels) {
            pixel &= 0xFFFFFFU;
        }
        if (stood.pictures.empty() || stood.pictures.back().pixels != pixels) {
            stood.pictures.push_back({seam::clockNow(), 0, pixels});
        }
    };
    ReplayHooks hooks;
    hooks.picture = [&](std::int64_t moment, const RECT&, const seam::PixelView& stage) {
        if (moment == 0) { // the one moment before which nobody is asked
            stood.pictures.clear();
            look({stage.bits,
                  stage.bits + static_cast<std::ptrdiff_t>(stage.stride) * stage.height});
        }
    };
    hooks.goesOn = [&] {
        if (seam::clockNow() > 0) {
            look(seam::windowPicture(FindWindowA("ReplayClass", "")).pixels);
        }
        return true;
    };
    stood.end = Replay(options, hooks).moment;
    for (std::size_t i = 1; i < stood.pictures.size(); ++i) {
        stood.pictures[i - 1].to = stood.pictures[i].from;
    }
    stood.pictures.back().to = stood.end + 1000; // the last one stays for a second
    return stood;
}

class Program : public ScratchDirectory {
  protected:
    /// Runs `toon` with these arguments; its words go to the file err. Gives the exit code.
    static int run(const std::string& arguments) {
        return runLine(DORBO_TOON " " + arguments + " >out 2>err");
    }

    static std::vector<std::string> files() {
        std::vector<std::string> found;
        for (const auto& entry : fs::recursive_directory_iterator(".")) {
            found.push_back(entry.path());
        }
        std::ranges::sort(found);
        return found;
    }
};

TEST_F(Program, FilmsWhatStoodOnTheStageInEachForm) {
    make("short.zkt", shortToon);
    make("stands.zkt", standsForGood);
    // File (none: a walk about), width, height, seed, and how many pictures there are at least.
    const std::tuple<std::string, int, int, std::uint32_t, std::size_t> cases[] = {
        {"short.zkt", 511, 303, 12, 30},
        {"stands.zkt", 320, 240, 1, 5},
        {"", 320, 240, 3, 30},
    };
    for (const auto& [file, width, height, seed, fewest] : cases) {
        ReplayOptions options;
        options.width = width;
        options.height = height;
        options.seed = seed;
        if (!file.empty()) {
            options.toons = {file};
        }
        const auto size = std::to_string(width) + "x" + std::to_string(height);
        const std::string arguments = (file.empty() ? "--walk-about" : file) + " --size=" + size +
                                      " --seed " + std::to_string(seed);
        SCOPED_TRACE(arguments);
        const Stood stood = watchStage(options);
        ASSERT_GT(stood.pictures.size(), fewest);
        for (const std::string out : {"film.gif", "film.PNG", "film"}) {
            ASSERT_EQ(run("film " + arguments + " " + out), 0) << textOf("err");
            EXPECT_EQ(textOf("err"), "");
            const Film film = out == "film.gif"   ? test::readGif(out)
                              : out == "film.PNG" ? test::readPng(out)
                                                  : test::readDirectory(out);
            EXPECT_EQ(film.width, options.width);
            EXPECT_TRUE(film.pictures == stood.pictures) << out;
        }
    }
}

TEST_F(Program, KeepsTheOnePictureOfAMoment) {
    make("short.zkt", shortToon);
    ReplayOptions options;
    options.toons = {"short.zkt"};
    const Stood stood = watchStage(options);
    for (const std::size_t i : {std::size_t{0}, std::size_t{1}, stood.pictures.size() - 1}) {
        const Shown& shown = stood.pictures[i];
        for (const std::int64_t moment : {shown.from, std::min(shown.to - 1, stood.end)}) {
            ASSERT_EQ(run("film short.zkt still.png --still " + std::to_string(moment)), 0);
            const Film film = test::readPng("still.png");
            ASSERT_EQ(film.pictures.size(), 1U);
            EXPECT_FALSE(film.forEver);
            EXPECT_TRUE(film.pictures[0].pixels == shown.pixels) << moment;
        }
    }
    EXPECT_EQ(run("film short.zkt late.png --still " + std::to_string(stood.end + 1)), 1);
    EXPECT_EQ(textOf("err"),
              "toon film: short.zkt: the show ends at " + std::to_string(stood.end) + " ms\n");
    EXPECT_FALSE(fs::exists("late.png"));
}

TEST_F(Program, TracesTheRecordInUtf8WithOneLineAnEvent) {
    make("short.zkt", toon({{60, 120, 2, 2, 0, "Caf\xE9,\rthen\ntea", 0}}));
    ReplayOptions options;
    options.toons = {"short.zkt"};
    options.width = 320;
    options.height = 240;
    std::string record;
    Replay(options, {[&](const std::string& line) {
               const std::size_t said = line.find("Caf\xE9");
               record += said == std::string::npos
                             ? line
                             : line.substr(0, said) + "Caf\xC3\xA9,\\rthen\\ntea";
               record += '\n';
           }});
    EXPECT_THAT(record, HasSubstr("tea"));
    EXPECT_EQ(run("trace --mode saver --size 320x240 short.zkt"), 0);
    EXPECT_EQ(textOf("out"), record);
    make("a.scene", "100 open short.zkt\n200 play\n");
    const std::tuple<const char*, const char*, bool> cases[] = {
        {"--shows 2 --paces 900", "shows=2", true},
        {"--paces 900", "odometer=9", true},
        {"--mode saver", "choice file=short.zkt", true},
        {"--mode player", "choice", false},
        {"--mode editor --script a.scene", "label=&Stop", true},
    };
    for (const auto& [given, told, isThere] : cases) {
        EXPECT_EQ(run("trace short.zkt " + std::string(given)), 0);
        EXPECT_EQ(textOf("out").find(told) != std::string::npos, isThere) << given;
    }
    setMode("short.zkt", 0400); // the saver would refuse it, and there would be nothing to tell
    EXPECT_EQ(run("trace short.zkt --size 320x240"), 0);
    EXPECT_EQ(textOf("out"), record);
}

TEST_F(Program, SaysWhatIsWrongAndLeavesNothing) {
    make("short.zkt", shortToon);
    make("out", "");
    make("err", "");
    make("taken.gif/file", "");
    make("mine/0001.png", "");
    make("no-toon.zkt", "frame\npause 1\n");
    make("no-frame.zkt", toon({}));
    const std::vector<std::string> before = files();
    const std::tuple<const char*, int, const char*> cases[] = {
        {"film short.zkt", 2, "toon film: it takes a FILE.zkt and one OUT\nusage: toon film FILE"},
        {"film --walk-about", 2, "toon film: with --walk-about it takes one OUT\n"},
        {"film short.zkt a.gif --shows 2", 2, "toon film: --shows is no option here\n"},
        {"film short.zkt a.gif --size 0x5", 2, "--size takes a width and a height of 1 to 8192"},
        {"film short.zkt a.gif --seed 4294967296", 2, ", not 4294967296\n"},
        {"film short.zkt a.gif --still 1s", 2, "--still takes a moment in milliseconds"},
        {"film short.zkt a.gif --mode editor", 2,
         "toon film: --mode takes saver or player, not editor\n"},
        {"trace short.zkt --script out", 2, "toon trace: --script is for --mode editor\n"},
        {"trace --mode editor --script missing", 1, "toon trace: missing: it can't be read\n"},
        {"film no-toon.zkt a.gif", 1,
         "toon film: no-toon.zkt: it is no Toon: of the header's 104 bytes it has 14\n"},
        {"film short.zkt missing/a.gif", 1, "toon film: missing/a.gif: No such file"},
        {"film short.zkt missing/a", 1, "toon film: missing/a: No such file"},
        {"film short.zkt taken.gif", 1, "toon film: taken.gif: it is no regular file\n"},
        {"film short.zkt a.jpg", 1, "a film ends in .gif or .png, or is a directory\n"},
        {"film short.zkt err", 1, "toon film: err: Not a directory\n"},
        {"film short.zkt mine", 1, "toon film: mine/0001.png: it is there, and of no film\n"},
        {"trace missing.zkt", 1, "toon trace: missing.zkt: it can't be read: No such file"},
        {"trace no-frame.zkt", 1, "toon trace: no-frame.zkt: it has no frame\n"},
    };
    for (const auto& [arguments, code, reason] : cases) {
        EXPECT_EQ(run(arguments), code) << arguments;
        EXPECT_THAT(textOf("err"), HasSubstr(reason)) << arguments;
        EXPECT_EQ(files(), before) << arguments;
    }
    const FullDisk full(3000);
    for (const std::string out : {"a.gif", "a.png", "a"}) {
        EXPECT_EQ(run("film short.zkt " + out), 1);
        EXPECT_THAT(textOf("err"), HasSubstr("File too large"));
        EXPECT_EQ(files(), before) << out;
    }
}

/// `toon` under way; its directory for passing files is one of the test's own.
pid_t start(const std::string& arguments) {
    const pid_t child = fork();
    if (child == 0) {
        setenv("TMPDIR", "passing", 1);
        execl("/bin/sh", "sh", "-c", ("exec " DORBO_TOON " " + arguments).c_str(), nullptr);
        _exit(127);
    }
    return child;
}

TEST_F(Program, LeavesNothingWhenItIsEndedFromOutside) {
    constexpr std::chrono::milliseconds look(1);
    std::vector<ToonFrame> frames;
    for (int i = 0; i < 100; ++i) { // far and wide, so that there is time to end it
        frames.push_back({i % 2 * 300, i % 3 * 100, 1, 30, 0, "On and on", 0});
    }
    make("long.zkt", toon(frames));
    make("old/times.txt", "");
    fs::create_directory("passing");
    const std::vector<std::string> before = files();
    const std::tuple<int, const char*, std::size_t> cases[] = {
        {SIGINT, "film --seed 2 --size 1024x768 long.zkt film.gif", 1}, // while it is planned
        {SIGINT, "film --seed 2 --size 1024x768 long.zkt film.gif", 7},
        {SIGTERM, "film --seed 2 --size 1024x768 long.zkt film.png", 7},
        {SIGHUP, "film --seed 2 --size 1024x768 long.zkt film", 9},
        {SIGINT, "film --seed 2 --size 1024x768 long.zkt old", 9},
        {SIGINT, "check long.zkt long.zkt long.zkt long.zkt", 1},
    };
    for (const auto& [signal, arguments, filesThere] : cases) {
        SCOPED_TRACE(arguments);
        const pid_t child = start(arguments);
        int status = 0;
        while (files().size() < before.size() + filesThere &&
               waitpid(child, &status, WNOHANG) == 0) {
            std::this_thread::sleep_for(look);
        }
        ASSERT_EQ(kill(child, signal), 0) << "it was over before";
        waitpid(child, &status, 0);
        EXPECT_TRUE(WIFSIGNALED(status) && WTERMSIG(status) == signal) << status;
        EXPECT_EQ(files(), before);
    }
}

} // namespace

// Runs of the real program: exit codes, modes, what ends it and what it leaves behind.
#include "tests/program/bitmaps.h"
#include "tests/program/ground.h"

#include <algorithm>
#include <fstream>

#include <gtest/gtest.h>

namespace {

using ground::Grab;
using ground::Ground;

constexpr int refused = 255;

class Run : public testing::Test {
  protected:
    void addToon(const std::string& name) {
        std::filesystem::copy_file(std::string(DORBO_SOURCE_DIR "/toons/") + name,
                                   ground.toons() / name);
    }

    /// Waits until the saver's title stands on the screen.
    void waitForSaver() {
        const ground::Picture tile = ground::loadPicture("bg01");
        ASSERT_TRUE(ground::waitFor([&] { return ground.grab().at(0, 0) == tile.at(0, 0); }));
    }

    /// The number behind a key of the settings file.
    int setting(const std::string& key) const {
        const std::string text = ground.settings();
        const auto at = text.find(key + "=");
        return at == std::string::npos ? -1 : std::stoi(text.substr(at + key.size() + 1));
    }

    Ground ground;
    Grab bare = ground.grab();
};

TEST_F(Run, CommandLineChoosesModeAndExitCode) {
    struct Case {
        std::vector<std::string> arguments;
        int code;
    };

    const Case cases[] = {
        {{"X"}, refused},       {{"9"}, refused},         {{"-\tS"}, refused},
        {{}, refused},          {{"/"}, refused},         {{"-", "--", "/"}, refused},
        {{"C"}, refused},       {{"/c:123"}, refused},    {{"P"}, refused},
        {{"P", "0"}, refused},  {{"P", "77"}, refused},   {{"/P:1"}, refused},
        {{"l", "-5"}, refused}, {{"P", "0x20"}, refused}, {{"A"}, 0},
        {{"/a", "12345"}, 0},   {{"--a:99"}, 0},          {{"P", "99999999999"}, refused},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(ground.start(c.arguments).exitCode(), c.code)
            << (c.arguments.empty() ? "nothing" : c.arguments.front());
    }
    EXPECT_EQ(ground.grab(), bare);
}

TEST_F(Run, KeyEndsTheSaverAndTheOdometerIsKept) {
    addToon("intro.zkt");
    auto saver = ground.start({"-/ Sanything"});
    waitForSaver();
    const Grab title = ground.grab();
    const auto settled = [&, last = title]() mutable {
        const Grab now = ground.grab();
        const bool moved = now != last;
        last = now;
        return moved;
    };
    ASSERT_TRUE(ground::waitFor(settled)) << "the title gives way to the caption";
    ASSERT_TRUE(ground::waitFor(settled)) << "he walks";
    ground.press("space");
    EXPECT_EQ(saver.exitCode(), 0);
    EXPECT_GT(setting("Paces Walked"), 0);
    EXPECT_EQ(setting("Walking Style"), 1);
    EXPECT_NE(ground.settings().find("Directory=C:\\"), std::string::npos);
    EXPECT_TRUE(ground::waitFor([&] { return ground.grab() == bare; })) << "the screen is back";
}

TEST_F(Run, WithoutToonsTheSettingsSayThatHeWalksAbout) {
    ground.writeSettings("[Fenky Dorbo Screen Saver]\r\nBackgrounds=0\r\n");
    auto saver = ground.start({"S"});
    waitForSaver();
    ground.press("Escape");
    EXPECT_EQ(saver.exitCode(), 0);
    EXPECT_EQ(setting("Walking Style"), 0);
    EXPECT_EQ(setting("Backgrounds"), 1);
}

TEST_F(Run, SecondSaverBringsTheFirstToTheFront) {
    auto first = ground.start({"S"});
    waitForSaver();
    EXPECT_EQ(ground.start({"S"}).exitCode(), 0);
    EXPECT_TRUE(first.running());
    ground.press("a");
    EXPECT_EQ(first.exitCode(), 0);
    EXPECT_TRUE(ground::waitFor([&] { return ground.grab() == bare; }));
}

TEST_F(Run, PreviewLivesInAnotherProgramsWindow) {
    const xcb_window_t host = ground.makeWindow(200, 150);
    const Grab empty = ground.grab(host);
    auto preview = ground.start({"/p", std::to_string(host)});
    ASSERT_TRUE(ground::waitFor([&] { return ground.grab(host) != empty; }));
    const auto covered = [&] {
        const Grab shown = ground.grab(host);
        return std::count(shown.pixels.begin(), shown.pixels.end(), empty.pixels.front()) == 0;
    };
    ASSERT_TRUE(ground::waitFor(covered));
    ground.press("space", ground.childOf(host));
    // The key has come and gone by the time the host's new size has been followed.
    ground.resizeWindow(host, 320, 240);
    ASSERT_TRUE(ground::waitFor([&] { return ground.grab(host).width == 320 && covered(); }));
    EXPECT_TRUE(preview.running());
    ground.destroyWindow(host);
    EXPECT_EQ(preview.exitCode(), 0);
}

TEST_F(Run, ToonThatDoesNotLoadShowsItsBoxAndAKeyEndsTheSaver) {
    std::ofstream(ground.toons() / "intro.zkt") << "too short";
    auto saver = ground.start({"S"});
    waitForSaver();
    const Grab title = ground.grab();
    Grab box;
    ASSERT_TRUE(ground::waitFor([&] { return (box = ground.grab()) != title; }));
    EXPECT_EQ(box.at(400, 10), title.at(400, 10)) << "the stage stands behind the box";
    // The box takes the keyboard; its answer leaves the stage as it stood.
    const auto answered = [&] {
        ground.press("Return"); // seen only once it has the keyboard
        return ground::waitFor([&] { return ground.grab() == title; }, 1);
    };
    ASSERT_TRUE(ground::waitFor(answered));
    EXPECT_TRUE(saver.running());
    ground.press("space");
    EXPECT_EQ(saver.exitCode(), 0);
}

TEST(NoDisplay, IsSaidAndRefused) {
    const auto directory = std::filesystem::temp_directory_path();
    const std::map<std::string, std::string> none{{"DISPLAY", ":4095"}};
    EXPECT_EQ(ground::Process({DORBO_PROGRAM, "S"}, none, directory).exitCode(), refused);
    EXPECT_EQ(ground::Process({DORBO_PROGRAM, "A"}, none, directory).exitCode(), 0);
}

} // namespace

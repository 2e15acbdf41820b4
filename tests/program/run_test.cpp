// Runs of the real program: exit codes, modes, what ends it and what it leaves behind.
#include "tests/program/run.h"

#include <csignal>

namespace {

using ground::Run;

constexpr int refused = 255;

TEST_F(Run, CommandLineChoosesModeAndExitCode) {
    const struct {
        std::vector<std::string> arguments;
        int code;
    } cases[] = {
        {{"X"}, refused},      {{"7"}, refused},       {{"-\tS"}, refused}, {{"P"}, refused},
        {{"P", "0"}, refused}, {{"P", "77"}, refused}, {{"/P:1"}, refused}, {{"l", "-5"}, refused},
    };

    for (const auto& one : cases) {
        EXPECT_EQ(ground.start(one.arguments).exitCode(), one.code)
            << testing::PrintToString(one.arguments);
    }
    EXPECT_TRUE(ground.grab() == bare);
}

TEST_F(Run, SetupIsShownAndSavesTheSettings) {
    const std::vector<std::string> lines[] = {{}, {"-", "--", "/"}, {"/c:123"}};
    for (const auto& arguments : lines) {
        std::filesystem::remove(ground.settings());
        auto setup = ground.start(arguments);
        ground.typeInto("Fenky Dorbo's Rematch", ""); // Return: OK
        EXPECT_EQ(setup.exitCode(), 1) << testing::PrintToString(arguments);
        EXPECT_EQ(setting("Walking Style"), "1");
    }
    auto ended = ground.start({});
    const QImage empty = ground.grab();
    ASSERT_TRUE(ground::waitFor([&] { return ground.grab() != empty; }));
    ended.signal(SIGTERM);
    EXPECT_EQ(ended.exitCode(), 255);
    EXPECT_TRUE(ground::waitFor([&] { return ground.grab() == bare; }));
}

TEST_F(Run, DialogsStandBeforeTheWindowThatIsMeantAndTakeTheirLetters) {
    const xcb_window_t other = ground.makeWindow(50, 50);
    const std::string number = std::to_string(other);
    const auto line = [&](const std::string& words) {
        return ground.launch({"sh", "-c", words}).readLine();
    };
    const char* const setup = "Fenky Dorbo's Rematch";

    const struct {
        std::vector<std::string> arguments;
        const char* title;
        bool before; // the other window, which has the keyboard
        const char* keys;
        std::string settings;
    } cases[] = {{{}, setup, false, "alt+w alt+a Escape", "111"},
                 {{"C"}, setup, true, "alt+w alt+a Return", "001"},
                 {{"C"}, setup, true, "alt+u alt+p alt+o", "100"},
                 {{"C"}, setup, true, "alt+w alt+c", "100"},
                 {{"A", number}, "Change Password", true, "Escape", "100"},
                 {{"A", "77"}, "Change Password", true, "Escape", "100"},
                 {{"/a"}, "Change Password", true, "Escape", "100"}};

    for (const auto& [arguments, title, before, keys, settings] : cases) {
        ASSERT_EQ(ground.command({"xdotool", "windowfocus", "--sync", number}), 0);
        auto program = ground.start(arguments);
        const std::string found =
            "$(xdotool search --sync --onlyvisible --name \"" + std::string(title) + "\")";
        const std::string owner = line("xprop -id " + found + " WM_TRANSIENT_FOR");
        char id[16];
        std::snprintf(id, sizeof id, "0x%x", other);
        EXPECT_EQ(owner.ends_with(id), before) << keys << ": " << owner;
        line("xdotool windowfocus --sync " + found + " key " + keys);
        EXPECT_EQ(program.exitCode(), title == setup ? 1 : 0) << keys;
        EXPECT_EQ(setting("Walking Style") + setting("Statements") + setting("Backgrounds"),
                  settings)
            << keys;
    }
}

TEST_F(Run, KeyEndsTheSaverAndTheOdometerIsKept) {
    addToon("intro.zkt");
    const auto powerSaving = [&] {
        const std::string told =
            "xset q | sed -n '/Screen Saver/,/Colors/p; /DPMS/,$p' | tr '\\n' ' '";
        return ground.launch({"sh", "-c", told}).readLine();
    };
    const std::string before = powerSaving();
    ASSERT_NE(before, "");
    auto saver = ground.start({"-/ Sanything"});
    waitForSaver();
    EXPECT_EQ(powerSaving(), before) << "the machine's own timers stay as they are";
    const QImage title = ground.grab();
    const auto settled = [&, last = title]() mutable {
        const QImage now = ground.grab();
        const bool moved = now != last;
        last = now;
        return moved;
    };
    ASSERT_TRUE(ground::waitFor(settled)) << "the title gives way to the caption";
    ASSERT_TRUE(ground::waitFor(settled)) << "he walks";
    ground.press("space");
    EXPECT_EQ(saver.exitCode(), 0);
    EXPECT_GT(std::stoi(setting("Paces Walked")), 0);
    EXPECT_EQ(setting("Walking Style"), "1");
    EXPECT_EQ(setting("Directory").substr(0, 3), "C:\\");
    EXPECT_TRUE(ground::waitFor([&] { return ground.grab() == bare; })) << "the screen is back";
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
    const QImage empty = ground.grab(host);
    auto preview = ground.start({"/l", std::to_string(host)});
    ASSERT_TRUE(ground::waitFor([&] { return ground.grab(host) != empty; }));
    const auto covered = [&] {
        const QImage shown = ground.grab(host);
        for (int y = 0; y < shown.height(); ++y) {
            for (int x = 0; x < shown.width(); ++x) {
                if (shown.pixel(x, y) == empty.pixel(0, 0)) {
                    return false;
                }
            }
        }
        return true;
    };
    ASSERT_TRUE(ground::waitFor(covered));
    ground.press("space", ground.childOf(host));
    // The key has come and gone by the time the host's new size has been followed.
    ground.resizeWindow(host, 320, 240);
    ASSERT_TRUE(ground::waitFor([&] { return ground.grab(host).width() == 320 && covered(); }));
    EXPECT_TRUE(preview.running());
    ground.destroyWindow(host);
    EXPECT_EQ(preview.exitCode(), 0);
}

TEST_F(Run, ToonThatDoesNotLoadShowsItsBoxAndAKeyEndsTheSaver) {
    std::ofstream(ground.toons() / "intro.zkt") << "too short";
    auto saver = ground.start({"S"});
    waitForSaver();
    const QImage title = ground.grab();
    QImage box;
    ASSERT_TRUE(ground::waitFor([&] { return (box = ground.grab()) != title; }));
    EXPECT_EQ(box.pixel(400, 10), title.pixel(400, 10)) << "the stage stands behind the box";
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
    const auto none = ground::environmentFor(":4095");
    EXPECT_EQ(ground::Process({DORBO_PROGRAM, "S"}, none, directory).exitCode(), refused);
    EXPECT_EQ(ground::Process({DORBO_PROGRAM, "A"}, none, directory).exitCode(), 0);
}

} // namespace

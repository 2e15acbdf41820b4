// The real saver has the screen to itself: every monitor, the front, keyboard and pointer; and what
// makes it let go.
#include "tests/program/run.h"

#include <csignal>

namespace {

using ground::Run;
using ground::waitFor;

constexpr int right = 700; // a pixel of the second monitor, where there is one

class Screen : public Run {
  protected:
    /// Lays a monitor over a part of the screen, or takes it away.
    void setMonitor(const std::string& name, const std::string& place, const std::string& output) {
        ASSERT_EQ(ground.command({"xrandr", "--setmonitor", name, place, output}), 0);
    }

    void dropMonitor(const std::string& name) {
        ASSERT_EQ(ground.command({"xrandr", "--delmonitor", name}), 0);
    }

    bool turns(int x, QRgb colour) const {
        return waitFor([&] { return ground.grab().pixel(x, 100) == colour; });
    }

    bool moves(int x, int y) const {
        return ground.command({"xdotool", "mousemove", std::to_string(x), std::to_string(y)}) == 0;
    }

    /// Colours the bare screen, so that black on it is seen.
    void SetUp() override {
        ASSERT_EQ(ground.command({"xsetroot", "-solid", "#336699"}), 0);
    }

    void setPassword(const std::string& password) {
        auto dialog = ground.start({"A"});
        ASSERT_TRUE(endsOnTyping(dialog, "Change Password", password + "\t" + password));
        ASSERT_EQ(dialog.exitCode(), 0);
    }

    /// Types until the process ends: the first keys may come before the dialog has the keyboard,
    /// or while it holds OK back after a wrong password.
    bool endsOnTyping(ground::Process& process, const std::string& title,
                      const std::string& text) const {
        return waitFor([&] {
            ground.press("ctrl+u");
            ground.typeInto(title, text);
            return waitFor([&] { return !process.running(); }, 0.5);
        });
    }

    static constexpr QRgb root = 0xFF336699;
    static constexpr QRgb black = 0xFF000000;
};

TEST_F(Screen, EveryMonitorIsCoveredAlsoOneThatComesLater) {
    setMonitor("L", "600/200x600/200+0+0", "screen");
    auto saver = ground.start({"S"});
    waitForSaver();
    EXPECT_TRUE(turns(right, root)) << "there is no monitor there";
    setMonitor("R", "200/100x600/200+600+0", "none");
    EXPECT_TRUE(turns(right, black));
    dropMonitor("R");
    EXPECT_TRUE(turns(right, root));
    setMonitor("R", "200/100x600/200+600+0", "none");
    EXPECT_TRUE(turns(right, black));
    ASSERT_TRUE(saver.running());
    moves(right, 300);
    EXPECT_EQ(saver.exitCode(), 0) << "input on the black counts";
}

TEST_F(Screen, TheShowFollowsItsMonitor) {
    setMonitor("L", "400/200x400/200+0+0", "screen");
    auto saver = ground.start({"S"});
    waitForSaver();
    dropMonitor("L");
    EXPECT_TRUE(waitFor([&] { return ground.grab().pixel(790, 590) != root; }));
    EXPECT_TRUE(saver.running());
}

TEST_F(Screen, NothingThatAppearsLaterLiesAboveIt) {
    auto saver = ground.start({"S"});
    waitForSaver();
    const QImage before = ground.grab();
    ground.makeWindow(100, 100);
    EXPECT_TRUE(waitFor([&] { return ground.grab().pixel(30, 30) == before.pixel(30, 30); }));
    EXPECT_TRUE(saver.running());
}

TEST_F(Screen, EndsWhenAnotherWindowKeepsTheKeyboardNotWhenNoneHasIt) {
    ground.loseManager();
    const xcb_window_t other = ground.makeWindow(50, 50);
    auto saver = ground.start({"S"});
    waitForSaver();
    ground.focus(0); // as a compositor does that sees to the keyboard itself
    EXPECT_FALSE(waitFor([&] { return !saver.running(); }, 1));
    ground.press("a"); // of which it hears nothing
    EXPECT_TRUE(saver.running());
    moves(300, 300);
    EXPECT_EQ(saver.exitCode(), 0);

    auto second = ground.start({"S"});
    waitForSaver();
    ground.focus(other);
    EXPECT_EQ(second.exitCode(), 0);
}

TEST_F(Screen, SignalsEndItWithTheSettingsSaved) {
    setPassword("sesame");
    for (const int number : {SIGTERM, SIGINT, SIGHUP}) {
        std::filesystem::remove(ground.settings());
        auto saver = ground.start({"S"});
        waitForSaver();
        saver.signal(number);
        EXPECT_EQ(saver.exitCode(), 0) << number;
        EXPECT_EQ(setting("Walking Style"), "0");
        EXPECT_TRUE(ground.inputIsFree());
    }
    auto change = ground.start({"A"});
    ground.typeInto("Change Password", "s");
    change.signal(SIGTERM);
    EXPECT_EQ(change.exitCode(), 0);
}

TEST_F(Screen, ADisplayThatGoesInMidShowEndsItWithinASecondAndItsPacesCount) {
    addToon("intro.zkt");
    // What the toolkit says of it goes to somebody who reads no more.
    auto saver = ground.launch({"bash", "-c", "exec " DORBO_PROGRAM " S 2> >(:)"});
    waitForSaver();
    for (int change = 0; change < 5; ++change) { // the title goes, he comes in, and walks
        ASSERT_TRUE(waitFor([&, last = ground.grab()] { return ground.grab() != last; }));
    }
    std::filesystem::remove(ground.settings());
    ground.loseDisplay();
    EXPECT_TRUE(waitFor([&] { return !saver.running(); }, 1));
    EXPECT_EQ(setting("Walking Style"), "1");
    EXPECT_GT(std::atoi(setting("Paces Walked").c_str()), 0);
}

TEST_F(Screen, ThePasswordKeepsItUp) {
    const std::string title = "Screen Saver Password";
    const auto asks = [&] {
        return ground.command({"xdotool", "search", "--onlyvisible", "--name", title}) == 0;
    };
    setPassword("sesame");
    ASSERT_TRUE(ground.takeInput()); // and the saver tries until it has it
    auto saver = ground.start({"S"});
    waitForSaver();
    ground.giveInputBack();
    EXPECT_TRUE(waitFor([&] { return !ground.inputIsFree(); }));

    ground.press("a");
    ground.typeInto(title, "wrong");
    EXPECT_FALSE(ground.inputIsFree());
    ASSERT_TRUE(asks());
    EXPECT_EQ(ground.start({"S"}).exitCode(), 0);
    constexpr QRgb dialog = 0xFFC0C0C0;
    EXPECT_TRUE(waitFor([&] { return ground.grab().pixel(240, 300) == dialog; }))
        << "a second saver brings the first to the front, but not above its dialog";
    ground.press("Escape");
    ASSERT_TRUE(waitFor([&] { return !asks(); }));
    EXPECT_FALSE(ground.inputIsFree());
    ASSERT_TRUE(saver.running());

    ground.press("a");
    EXPECT_TRUE(endsOnTyping(saver, title, "sesame"));
    EXPECT_EQ(saver.exitCode(), 0);
    EXPECT_TRUE(ground.inputIsFree());
}

} // namespace

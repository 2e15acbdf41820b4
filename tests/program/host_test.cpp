// The show in windows of programs that host savers: what it does there, what ends it, and the real
// hosts.
#include "tests/program/run.h"

#include <csignal>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

using ground::Process;
using ground::Run;
using ground::waitFor;

using Words = std::vector<std::string>;

class Host : public Run {
  protected:
    using Run::Run;

    /// Starts dorbo-hack with what a host gives it; no variable if that is empty.
    Process hack(const std::string& variable, const Words& arguments = {}) const {
        Words words{"env", "-u", "XSCREENSAVER_WINDOW"};
        if (!variable.empty()) {
            words.push_back("XSCREENSAVER_WINDOW=" + variable);
        }
        words.emplace_back(DORBO_HACK);
        words.insert(words.end(), arguments.begin(), arguments.end());
        return ground.launch(words);
    }

    static std::string hex(xcb_window_t window) {
        char text[16];
        std::snprintf(text, sizeof text, "0x%X", window);
        return text;
    }

    /// Waits until the picture of a window, or of the screen, changes that often.
    bool changes(int times, xcb_window_t window = 0) const {
        QImage last = ground.grab(window);
        return waitFor([&] {
            const QImage now = ground.grab(window);
            times -= now != last ? 1 : 0;
            last = now;
            return times <= 0;
        });
    }

    /// Whether the picture of a window has none of its own colour left.
    bool covered(xcb_window_t window) const {
        const QImage shown = ground.grab(window);
        for (int y = 0; y < shown.height(); ++y) {
            for (int x = 0; x < shown.width(); ++x) {
                if (shown.pixel(x, y) == bareColour) {
                    return false;
                }
            }
        }
        return !shown.isNull();
    }

    /// How many keys the settings file holds.
    std::ptrdiff_t settingsSaved() const {
        std::ifstream file(ground.settings());
        return std::count(std::istreambuf_iterator<char>(file), {}, '=');
    }

    static constexpr std::ptrdiff_t allSettings = 5;
    static constexpr QRgb bareColour = 0xFF305A8C; // of the windows that Ground makes
};

TEST_F(Host, ShowsTheWholeShowAndTakesNoInput) {
    const xcb_window_t host = ground.makeWindow(400, 300);
    auto saver = hack(hex(host), {"-root"});
    ASSERT_TRUE(waitFor([&] { return covered(host); }));
    EXPECT_TRUE(ground.inputIsFree());
    EXPECT_TRUE(ground.clickReaches(host));
    ground.press("space", ground.childOf(host));
    saver.signal(SIGUSR1);
    ground.resizeWindow(host, 500, 350);
    EXPECT_TRUE(waitFor([&] { return ground.grab(host).width() == 500 && covered(host); }));
    EXPECT_TRUE(changes(5, host)) << "the titles go, and he walks";
    EXPECT_TRUE(saver.running());
    saver.signal(SIGTERM);
    EXPECT_EQ(saver.exitCode(), 0);
    EXPECT_GT(std::stoi(setting("Paces Walked")), 0);
    EXPECT_EQ(std::distance(fs::directory_iterator(ground.toonHome()), {}),
              std::distance(fs::directory_iterator(DORBO_TOONS), {}));
    EXPECT_TRUE(setting("Directory").ends_with("\\data\\dorbo\\toons\\"));
}

TEST_F(Host, EndsWithTheSettingsSavedWhateverEndsIt) {
    for (const int number : {SIGTERM, SIGINT, SIGHUP, 0}) {
        fs::remove(ground.settings());
        const xcb_window_t host = ground.makeWindow(200, 150);
        auto saver = hack(std::to_string(host));
        ASSERT_TRUE(waitFor([&] { return covered(host); }));
        if (number != 0) {
            saver.signal(number);
        } else {
            ground.destroyWindow(host);
        }
        EXPECT_EQ(saver.exitCode(), 0) << number;
        EXPECT_EQ(settingsSaved(), allSettings) << number;
        ground.destroyWindow(host);
    }
    const xcb_window_t host = ground.makeWindow(200, 150);
    auto saver = hack(hex(host));
    ASSERT_TRUE(waitFor([&] { return covered(host); }));
    fs::remove(ground.settings());
    ground.loseDisplay();
    EXPECT_TRUE(waitFor([&] { return !saver.running(); }, 1));
    EXPECT_EQ(settingsSaved(), allSettings);
}

TEST_F(Host, OneForEachMonitorMayEndAtTheSameMoment) {
    const xcb_window_t left = ground.makeWindow(300, 200);
    const xcb_window_t right = ground.makeWindow(300, 200);
    ground.command({"xdotool", "windowmove", std::to_string(right), "400", "20"});
    auto first = hack(hex(left));
    auto second = hack(hex(right));
    ASSERT_TRUE(changes(5, left) && changes(5, right)) << "both walk";
    first.signal(SIGTERM);
    second.signal(SIGTERM);
    EXPECT_EQ(first.exitCode(), 0);
    EXPECT_EQ(second.exitCode(), 0);
    EXPECT_EQ(settingsSaved(), allSettings);
    EXPECT_GT(std::stoi(setting("Paces Walked")), 0);
}

TEST_F(Host, AToonThatDoesNotLoadBringsNoBox) {
    fs::create_directories(ground.toonHome());
    std::ofstream(ground.toonHome() / "intro.zkt") << "too short";
    const xcb_window_t host = ground.makeWindow(400, 300);
    auto saver = hack(hex(host));
    ASSERT_TRUE(changes(5, host)) << "he walks about";
    EXPECT_NE(ground.command({"xdotool", "search", "--onlyvisible", "--name", "Error"}), 0);
    saver.signal(SIGTERM);
    EXPECT_EQ(saver.exitCode(), 0);
}

TEST_F(Host, OnTheDesktopItLiesBehindEverythingAndNobodyNoticesIt) {
    const xcb_window_t other = ground.makeWindow(100, 100);
    const QImage before = ground.grab(other);
    auto saver = hack("", {"--root"});
    waitForSaver();
    EXPECT_EQ(ground.grab().pixel(30, 30), before.pixel(10, 10));
    EXPECT_TRUE(ground.clickReaches(other));
    EXPECT_TRUE(changes(5));
    saver.signal(SIGTERM);
    EXPECT_EQ(saver.exitCode(), 0);
}

TEST_F(Host, AVirtualRootTakesThePlaceOfTheRootWindow) {
    const xcb_window_t root = ground.makeWindow(300, 200);
    ASSERT_EQ(ground.command({"xprop", "-id", std::to_string(root), "-format", "__SWM_VROOT", "32x",
                              "-set", "__SWM_VROOT", hex(root)}),
              0);
    auto saver = hack("", {"-root"});
    EXPECT_TRUE(waitFor([&] { return covered(root); }));
    ground.destroyWindow(root);
    EXPECT_EQ(saver.exitCode(), 0);
}

TEST_F(Host, WithoutAWindowItSaysSoAndEnds) {
    const struct {
        const char* variable;
        Words arguments;
        int code;
    } cases[] = {{"", {}, 1},
                 {"0x77", {}, 1},
                 {"", {"-window-id", "0x1FFFFFF0"}, 1},
                 {"none", {}, 1},
                 {"", {"S"}, 2},
                 {"", {"--window-id", "-1"}, 2},
                 {"", {"--help"}, 0},
                 {"", {"-root", "--fps"}, 2}};

    for (const auto& one : cases) {
        EXPECT_EQ(hack(one.variable, one.arguments).exitCode(), one.code)
            << one.variable << testing::PrintToString(one.arguments);
    }
    EXPECT_TRUE(ground.grab() == bare);
}

// ---- Real hosts --------------------------------------------------------------------------------

/// As it is installed, for a user of no privileges: what a host of another user can read.
class RealHost : public Host {
  protected:
    RealHost() : Host(QSize(1200, 800)) {} // the dialog has to fit

    void SetUp() override {
        fs::create_directories(program().parent_path());
        fs::create_directories(prefix() / "share/dorbo");
        fs::copy_file(DORBO_HACK, program());
        fs::copy(DORBO_TOONS, prefix() / "share/dorbo/toons");
        std::ofstream(ground.home() / ".xscreensaver")
            << "mode: one\nselected: 0\nlock: False\nfade: False\nunfade: False\nsplash: False\n"
            << "timeout: 1:00:00\ndpmsEnabled: False\n"
            << "programs: \"Dorbo\" " << program().string() << " --root \\n\n";
    }

    fs::path prefix() const {
        return ground.home() / "prefix";
    }

    fs::path program() const {
        return prefix() / "libexec/xscreensaver/dorbo-hack";
    }

    /// The words that run a command as an ordinary user, who owns the home from then on: some hosts
    /// start no savers for root.
    Words asUser(const Words& command) const {
        if (geteuid() != 0) {
            return command;
        }
        const std::string user = "4242";
        ground.command({"chown", "-R", user + ":" + user, ground.home().string()});
        Words words{"setpriv", "--reuid", user, "--regid", user, "--clear-groups"};
        words.insert(words.end(), command.begin(), command.end());
        return words;
    }

    /// The window of this name with a picture of the show in it; 0 if it doesn't come.
    xcb_window_t showIn(const std::string& name) const {
        xcb_window_t found = 0;
        waitFor([&] {
            auto search = ground.launch({"xdotool", "search", "--name", "^" + name + "$"});
            for (std::string line; !(line = search.readLine()).empty();) {
                const auto window = static_cast<xcb_window_t>(std::stoul(line));
                found = ground.childOf(window) != 0 ? window : found;
            }
            return found != 0;
        });
        return found != 0 && changes(5, found) ? found : 0;
    }
};

TEST_F(RealHost, XScreenSaverShowsItOnTheWholeScreen) {
    auto host = ground.launch(asUser({"xscreensaver", "--no-splash"}));
    const auto tells = [&](const char* what) {
        return ground.command({"xscreensaver-command", what}) == 0;
    };
    ASSERT_TRUE(waitFor([&] { return tells("-activate"); }));
    waitForSaver();
    EXPECT_TRUE(changes(5));
    fs::remove(ground.settings());
    ASSERT_TRUE(tells("-deactivate"));
    EXPECT_TRUE(waitFor([&] { return settingsSaved() == allSettings; }));
    EXPECT_TRUE(waitFor([&] { return ground.grab() == bare; }));
    EXPECT_TRUE(tells("-exit"));
    EXPECT_EQ(host.exitCode(), 0);
}

TEST_F(RealHost, XScreenSaverShowsItInItsSettings) {
    auto host = ground.launch(asUser({"xscreensaver", "--no-splash"})); // or the dialog asks for it
    ASSERT_TRUE(waitFor([&] { return ground.command({"xscreensaver-command", "-version"}) == 0; }));
    auto dialog = ground.launch(asUser({"xscreensaver-settings"}));
    EXPECT_NE(showIn("XScreenSaver Settings Preview"), 0U);
    dialog.signal(SIGKILL);
    EXPECT_TRUE(waitFor([&] { return settingsSaved() == allSettings; }))
        << "nobody has told it to end";
}

TEST_F(RealHost, XSecureLockShowsItOnEveryMonitor) {
    ground.command({"xrandr", "--setmonitor", "L", "600/100x800/150+0+0", "screen"});
    ground.command({"xrandr", "--setmonitor", "R", "600/100x800/150+600+0", "none"});
    const fs::path module = prefix() / "libexec/xsecurelock/saver_dorbo";
    fs::create_directories(module.parent_path());
    fs::create_symlink("../xscreensaver/dorbo-hack", module);
    auto host = ground.launch({"env", "XSECURELOCK_NO_COMPOSITE=1", "XSECURELOCK_BLANK_TIMEOUT=-1",
                               "XSECURELOCK_SAVER=" + module.string(), "xsecurelock"});
    const QRgb corner = ground::loadPicture("bg01").pixel(0, 0);
    EXPECT_TRUE(waitFor([&] {
        const QImage now = ground.grab();
        return now.pixel(0, 0) == corner && now.pixel(600, 0) == corner;
    }));
    EXPECT_TRUE(changes(5));
    host.signal(SIGTERM);
    EXPECT_TRUE(waitFor([&] { return settingsSaved() == allSettings; }));
    EXPECT_TRUE(waitFor([&] { return ground.grab() == bare; }));
}

} // namespace

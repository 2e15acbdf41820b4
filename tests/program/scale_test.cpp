// Screens of any density: each pixel of his is a square of whole ones, as large as the desktop or
// the user says.
#include "tests/program/run.h"

namespace {

using ground::waitFor;

constexpr QSize screen(1280, 960);

std::vector<std::string> saverWith(const std::string& setting) {
    std::vector<std::string> words{"env", "-u", "DORBO_SCALE"};
    if (!setting.empty()) {
        words.push_back(setting);
    }
    words.insert(words.end(), {DORBO_PROGRAM, "S"});
    return words;
}

QImage enlarged(const QImage& picture, int scale) {
    return picture.scaled(picture.size() * scale);
}

/// The title on a screen of this size, a pixel a pixel.
QImage plainTitle(QSize size) {
    const ground::Ground ground(size.width(), size.height());
    const QImage bare = ground.grab();
    auto saver = ground.launch(saverWith("DORBO_SCALE=1"));
    QImage shown;
    waitFor([&] { return (shown = ground.grab()) != bare; });
    return shown;
}

/// Whether the picture is made of squares of this size.
bool isWhole(const QImage& picture, int scale) {
    return enlarged(picture.scaled(picture.size() / scale), scale) == picture;
}

class Scaled : public ground::Run {
  protected:
    Scaled() : Run(screen) {}

    void setMonitors() {
        for (const char* monitor :
             {"L 640/200x960/200+0+0 screen", "R 640/200x960/200+640+0 none"}) {
            const std::string command = std::string("xrandr --setmonitor ") + monitor;
            ASSERT_EQ(ground.command({"sh", "-c", command}), 0);
        }
    }

    void setDensity(int dots) {
        const std::string resource = "echo Xft.dpi: " + std::to_string(dots) + " | xrdb -merge";
        ASSERT_EQ(ground.command({"sh", "-c", resource}), 0);
    }
};

struct Case {
    const char* name;
    int dots; // to the inch, as the desktop says
    const char* setting;
    int scale;
};

class Scale : public Scaled, public testing::WithParamInterface<Case> {};

TEST_P(Scale, TheTitleIsThatOfASmallerScreen) {
    const auto& [name, dots, setting, scale] = GetParam();
    const QImage wanted = enlarged(plainTitle(screen / scale), scale);
    setDensity(dots);
    auto saver = ground.launch(saverWith(setting));
    EXPECT_TRUE(waitFor([&] { return ground.grab() == wanted; }, 5));
}

constexpr Case cases[] = {
    {"TheDesktopSaysTwo", 192, "", 2},
    {"OfOneAndAHalfTheWholePart", 144, "", 1},
    {"OursIsStrongerThanTheDesktop", 192, "DORBO_SCALE=4", 4},
    {"OursIsTooLarge", 192, "DORBO_SCALE=9", 2},
    {"TheToolkitIsToldAFraction", 96, "QT_SCALE_FACTOR=2.5", 2},
    {"TheToolkitIsToldAFractionForAScreen", 96, "QT_SCREEN_SCALE_FACTORS=screen=2.5", 2},
};

INSTANTIATE_TEST_SUITE_P(Settings, Scale, testing::ValuesIn(cases),
                         [](const auto& one) { return one.param.name; });

TEST_F(Scaled, TheShowStaysWholeAndTheMouseCountsItsPixels) {
    setDensity(192);
    addToon("intro.zkt");
    ground.command({"xdotool", "mousemove", "100", "100"});
    auto saver = ground.launch(saverWith(""));
    int pictures = 0;
    QImage last = bare;
    EXPECT_TRUE(waitFor([&] {
        const QImage now = ground.grab();
        EXPECT_TRUE(isWhole(now, 2));
        pictures += now != last ? 1 : 0;
        last = now;
        return pictures > 8; // the title and steps of his
    }));
    ground.command({"xdotool", "mousemove", "106", "100", "click", "4"});
    EXPECT_FALSE(waitFor([&] { return !saver.running(); }, 0.5))
        << "three of his pixels, and a notch of the wheel";
    ground.command({"xdotool", "mousemove", "112", "100"});
    EXPECT_EQ(saver.exitCode(), 0);
}

TEST_F(Scaled, AHostOfAnOddSizeIsFilledAlsoWhenItGrows) {
    setDensity(192);
    const xcb_window_t host = ground.makeWindow(301, 201);
    const QRgb hostsOwn = ground.grab(host).pixel(0, 0);
    auto words = saverWith("");
    words.back() = "P";
    words.push_back(std::to_string(host));
    auto preview = ground.launch(words);
    const auto isFilled = [&](QSize size) {
        const QImage shown = ground.grab(host);
        bool filled = shown.size() == size;
        for (const QPoint corner :
             {QPoint(0, 0), QPoint(size.width() - 1, 0), QPoint(0, size.height() - 1),
              QPoint(size.width() - 1, size.height() - 1)}) {
            filled = filled && shown.pixel(corner) != hostsOwn;
        }
        return filled && isWhole(shown.copy(0, 0, size.width() & ~1, size.height() & ~1), 2);
    };
    EXPECT_TRUE(waitFor([&] { return isFilled({301, 201}); }, 5));
    ground.resizeWindow(host, 431, 333);
    EXPECT_TRUE(waitFor([&] { return isFilled({431, 333}); }, 5));
    EXPECT_TRUE(preview.running());
}

TEST_F(Scaled, NothingOfTheDisplayIsLeftUncovered) {
    ASSERT_EQ(ground.command({"xsetroot", "-solid", "#336699"}), 0);
    bare = ground.grab();
    const auto isCovered = [this] {
        const QImage shown = ground.grab();
        bool covered = true;
        for (int x = 0; x < screen.width(); ++x) {
            covered = covered && shown.pixel(x, screen.height() - 1) != bare.pixel(0, 0);
        }
        return covered;
    };
    {
        auto saver = ground.launch(saverWith("DORBO_SCALE=7")); // which leaves a row
        EXPECT_TRUE(waitFor(isCovered, 5));
    }
    setMonitors();
    for (const char* factors : {"2;1", "1;2"}) {
        EXPECT_TRUE(waitFor([&] { return ground.grab() == bare; }, 5));
        auto saver = ground.launch(saverWith(std::string("QT_SCREEN_SCALE_FACTORS=") + factors));
        EXPECT_TRUE(waitFor(isCovered, 5)) << factors;
    }
}

TEST_F(Scaled, TheEditorKeepsItsLooksOnAMonitorOfAnotherScale) {
    setMonitors();
    auto words = saverWith("QT_SCREEN_SCALE_FACTORS=2;1");
    words.back() = "C";
    auto setup = ground.launch(words);
    const auto run = [this](const std::string& line) {
        return ground.launch({"sh", "-c", line}).readLine();
    };
    const std::string find = "xdotool search --onlyvisible --name ";
    ground.command({"sh", "-c", find + "--sync Rematch windowactivate --sync key alt+e"});
    std::string editor;
    ASSERT_TRUE(waitFor([&] { return !(editor = run(find + "'Toon File Editor'")).empty(); }));
    const auto id = static_cast<xcb_window_t>(std::stoul(editor));
    // The texts on its two large buttons are the toolkit's, and finer.
    const auto upperPart = [&] {
        const QImage all = ground.grab(id);
        return all.copy(0, 0, all.width(), all.height() * 9 / 10 & ~1);
    };
    QImage large;
    ASSERT_TRUE(waitFor([&] { return isWhole(large = upperPart(), 2); }));
    const QImage caption = large.scaled(large.size() / 2).copy(0, 0, large.width() / 2, 60);
    const auto looksRight = [&](int scale) {
        const QImage now = upperPart();
        return now.width() == caption.width() * scale && isWhole(now, scale) &&
               now.copy(0, 0, now.width(), 60 * scale) == enlarged(caption, scale);
    };
    ground.command({"xdotool", "windowmove", editor, "700", "20"});
    EXPECT_TRUE(waitFor([&] { return looksRight(1); }, 5));
    ground.command({"xdotool", "windowmove", editor, "10", "20"});
    EXPECT_TRUE(waitFor([&] { return looksRight(2); }, 5));
}

} // namespace

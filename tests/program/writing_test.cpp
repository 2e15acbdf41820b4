// A Toon is written from nothing, saved, opened again, played and edited, as a user does it: by
// clicks and keys on a real screen.
#include "tests/program/run.h"

#include <cstring>
#include <sstream>

#include <QPainter>

namespace {

using namespace ground;

constexpr QRect stage(25, 42, 590, 380); // on the screen
constexpr QPoint barEnd(528, 440);       // of the show's progress, on the screen
constexpr QPoint picker(35, 95);

constexpr const char* editor = "Fenky Dorbo Toon File Editor";
constexpr const char* poses = "dorbo"; // the picker has no title of its own

enum class By { key, mouse };

/// A frame as it is typed, clicked and picked.
struct Entry {
    const char* text;
    QPoint place; // on the stage, where he is clicked to
    int pose;     // from 1
    By by;
    bool wink;
    const char* pause;
};

const Entry entries[] = {{"Good morning!", {120, 200}, 2, By::key, true, "1"},
                         {"Two\nlines", {170, 260}, 5, By::mouse, false, "-4"},
                         {"", {100, 300}, 8, By::key, true, "2"},
                         {"Here?", {60, 200}, 1, By::mouse, false, "1x"},
                         {"Or there, in three\n\nlines?", {140, 120}, 7, By::mouse, true, "1"},
                         {"Bye", {200, 180}, 4, By::key, false, " 1"}};

/// What the file says: its header, and its frames as "x,y pose pause wink text".
const std::vector<std::string> written{"Tea for one|590x380|6 frames|speed 5|tile 3",
                                       "120,200 1 1 1 Good morning!",
                                       "170,260 4 1 0 Two\rlines",
                                       "100,300 7 2 1 ",
                                       "60,200 0 1 0 Here?",
                                       "140,120 6 1 1 Or there, in three\r\rlines?",
                                       "200,180 3 1 0 Bye"};

std::vector<std::string> told(const std::filesystem::path& toon) {
    std::ifstream file(toon, std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(file), {}};
    const auto number = [&](std::size_t at) {
        std::int32_t value = 0;
        std::memcpy(&value, &bytes[at], sizeof value);
        return std::to_string(value);
    };
    const auto half = [&](std::size_t at) {
        std::uint16_t value = 0;
        std::memcpy(&value, &bytes[at], sizeof value);
        return std::to_string(value);
    };
    if (bytes.size() < 104 || (bytes.size() - 104) % 92 != 0) {
        return {std::to_string(bytes.size()) + " bytes"};
    }
    std::vector<std::string> lines{std::string(&bytes[36]) + "|" + half(88) + "x" + half(90) + "|" +
                                   number(92) + " frames|speed " + number(96) + "|tile " +
                                   number(100)};
    for (std::size_t at = 104; at < bytes.size(); at += 92) {
        lines.push_back(number(at) + "," + number(at + 4) + " " + number(at + 8) + " " +
                        number(at + 12) + " " + number(at + 16) + " " + &bytes[at + 20]);
    }
    return lines;
}

class Writing : public Run {
  protected:
    Writing() : Run({640, 480}) {}

    /// Whether the window with this title comes to have the keyboard; with an empty one, the
    /// picker.
    bool comesUp(const std::string& title, double seconds) {
        return waitFor(
            [&] {
                active = ground.launch({"sh", "-c", "xdotool getactivewindow getwindowname 2>&1"})
                             .readLine();
                return active == title;
            },
            seconds);
    }

    void waitForWindow(const std::string& title) {
        if (!comesUp(title, 20)) {
            throw std::runtime_error(title + ", not " + active);
        }
    }

    /// Presses a key until it opens the window: it may come too early.
    void openBy(const std::string& key, const std::string& title) {
        const auto opened = [&] {
            ground.press(key);
            return comesUp(title, 1);
        };
        if (!waitFor(opened)) {
            throw std::runtime_error(title + ", not " + active);
        }
    }

    void keys(std::vector<std::string> pressed) {
        pressed.insert(pressed.begin(), {"xdotool", "key"});
        ground.command(pressed);
    }

    /// Writes into the field of a letter, in place of what stands there.
    void fill(const char* letter, const std::string& text) {
        keys({std::string("alt+") + letter, "ctrl+a", "BackSpace"});
        std::istringstream lines(text);
        for (std::string line; std::getline(lines, line);) {
            ground.command({"xdotool", "type", "--", line});
            if (!lines.eof()) {
                keys({"Return"});
            }
        }
    }

    void click(QPoint at) {
        ground.command(
            {"xdotool", "mousemove", std::to_string(at.x()), std::to_string(at.y()), "click", "1"});
    }

    void pick(int pose, By by) {
        keys({"alt+o"});
        waitForWindow(poses);
        if (by == By::key) {
            keys({std::to_string(pose)});
        } else {
            click(picker + QPoint(74 + (pose - 1) % 4 * 140, 74 + (pose - 1) / 4 * 141));
        }
    }

    void write(const Entry& entry, const std::string& title) {
        click(stage.topLeft() + entry.place);
        waitForWindow(editor);
        keys({"alt+t"});
        waitForWindow(title);
        fill("t", entry.text);
        fill("s", entry.pause);
        if (entry.wink) {
            keys({"alt+k"});
        }
        pick(entry.pose, entry.by);
        waitForWindow(title);
        keys({"alt+v"});
    }

    void configure(const std::string& title) {
        keys({"ctrl+g"});
        waitForWindow("Dorbo Toon Frame File");
        keys({"ctrl+a"});
        ground.command({"xdotool", "type", "Tea for one"});
        keys({"Tab", "Right", "Right", "Right", "Tab", "Tab", "Tab", "Down", "Down", "Return"});
        waitForWindow(title);
    }

    void expectFile(const std::vector<std::string>& expected) {
        const auto file = ground.toons() / "mine.zkt";
        waitFor([&] { return told(file) == expected; });
        EXPECT_EQ(told(file), expected);
    }

    bool stageIsEmpty() const {
        QImage empty(stage.size(), QImage::Format_RGB32);
        QPainter(&empty).fillRect(empty.rect(), QBrush(loadPicture("bg03")));
        return ground.grab().copy(stage) == empty;
    }

    std::string active; // the title of the window that has the keyboard

    void playToTheEnd() {
        ASSERT_TRUE(waitFor([&] { return stageIsEmpty(); })) << "the tile that was chosen";
        keys({"alt+p"});
        const auto lastFrame = [&] { return ground.grab().pixel(barEnd) == 0xFF000080; };
        ASSERT_FALSE(lastFrame());
        ASSERT_TRUE(waitFor(lastFrame, 60));
        EXPECT_FALSE(stageIsEmpty()) << "he is there";
        ASSERT_TRUE(waitFor([&] { return stageIsEmpty(); })) << "he has walked off";
    }
};

TEST_F(Writing, AToonComesToBeAndIsPlayed) {
    auto setup = ground.start({"C"});
    openBy("alt+e", editor);
    openBy("ctrl+e", "File: [Untitled]"); // which does nothing until he has said hello
    for (const Entry& entry : entries) {
        if (&entry != &entries[0]) {
            keys({"alt+n"});
        }
        write(entry, "File: [Untitled]");
    }
    configure("File: [Untitled]");
    keys({"ctrl+s"});
    ground.typeInto("Save Toon File", "mine.zkt");
    waitForWindow("File: [mine]");
    expectFile(written);

    keys({"alt+l", "n"}); // another one, and this one again
    waitForWindow("File: [Untitled]");
    keys({"ctrl+o"});
    ground.typeInto("Open Toon File", "mine.zkt");
    waitForWindow("File: [mine]");
    keys({"ctrl+e"});
    waitForWindow(editor);
    playToTheEnd();

    openBy("ctrl+e", "File: [mine]");
    keys({"alt+e", "Home"});
    fill("x", "");
    fill("y", "9999");
    keys({"alt+v", "alt+e", "Down", "Down", "alt+m", "d"}); // the third goes
    keys({"ctrl+e"});
    waitForWindow("Dorbo Toon Frame File");
    keys({"y"});
    waitForWindow(editor);
    std::vector<std::string> edited = written;
    edited[0].replace(edited[0].find('6'), 1, "5");
    edited[1].replace(0, 7, "295,630");
    edited.erase(edited.begin() + 3);
    expectFile(edited);
    keys({"alt+F4"});
    waitForWindow("Fenky Dorbo's Rematch");
    keys({"Return"});
    EXPECT_EQ(setup.exitCode(), 1);
}

} // namespace

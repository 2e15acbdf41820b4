// A Toon is written from nothing, saved, opened again, played and edited, as a user does it: by
// clicks and keys on a real screen.
#include "tests/program/editing.h"

#include <csignal>
#include <sstream>

namespace {

using namespace ground;

constexpr QPoint barEnd(528, 440); // of the show's progress

/// A frame as it is typed, clicked and picked.
struct Entry {
    const char* text;
    QPoint place; // on the stage, where he is clicked to
    int pose;     // from 1
    bool byMouse;
    bool wink;
    const char* pause;
};

/// A click on him would do nothing: he stands at the left.
const Entry entries[] = {{"Good morning!", {160, 200}, 2, false, true, "1"},
                         {"Two\nlines", {170, 260}, 5, true, false, "-4"},
                         {"", {150, 300}, 8, false, true, "2"},
                         {"Here?", {210, 200}, 1, true, false, "1x"},
                         {"Or there, in three\n\nlines?", {140, 120}, 7, true, true, "1"},
                         {"Bye", {200, 180}, 4, false, false, " 1"}};

const std::vector<std::string> written{"656|Tea for one|590x380|6|5|3",
                                       "160,200 1 1 1 Good morning!",
                                       "170,260 4 1 0 Two\rlines",
                                       "150,300 7 2 1 ",
                                       "210,200 0 1 0 Here?",
                                       "140,120 6 1 1 Or there, in three\r\rlines?",
                                       "200,180 3 1 0 Bye"};

class Writing : public Editing {
  protected:
    void fill(const std::string& text) {
        keys({"ctrl+a", "BackSpace"});
        std::istringstream lines(text);
        for (std::string line; std::getline(lines, line);) {
            ground.command({"xdotool", "type", "--", line});
            if (!lines.eof()) {
                keys({"Return"});
            }
        }
    }

    void write(const Entry& entry, const std::string& title) {
        click(stage.topLeft() + entry.place);
        waitForWindow(editor);
        keys({"alt+t"});
        waitForWindow(title);
        fill(entry.text);
        keys({"Tab", "Tab", "Tab"});
        fill(entry.pause);
        keys({"Tab", entry.wink ? "space" : "Tab", "alt+o"});
        waitForWindow(pickersTitle);
        if (entry.byMouse) {
            click(picker.topLeft() +
                  QPoint(74 + (entry.pose - 1) % 4 * 140, 74 + entry.pose / 5 * 141));
        } else {
            keys({std::to_string(entry.pose)});
        }
        waitForWindow(title);
        keys({"alt+v"});
    }

    void playToTheEnd() {
        const auto empty = [&] { return isEmpty("bg03"); };
        const auto lastFrame = [&] { return ground.grab().pixel(barEnd) == 0xFF000080; };
        ASSERT_TRUE(waitFor(empty)) << "the tile that was chosen";
        keys({"alt+p"});
        ASSERT_TRUE(waitFor([&] { return !empty() && lastFrame(); }, 60));
        ASSERT_TRUE(waitFor(empty)) << "he has walked off";
    }
};

TEST_F(Writing, AToonComesToBeAndIsPlayed) {
    auto setup = ground.start({});
    openFrameEditor();
    for (const Entry& entry : entries) {
        write(entry, "File: [Untitled]");
        keys({&entry == &entries[5] ? "ctrl+g" : "alt+n"});
    }
    waitForWindow("Dorbo Toon Frame File");
    ground.command({"xdotool", "type", "Tea for one"}); // in place of the caption
    keys({"Tab", "Right", "Right", "Right", "Tab", "Tab", "Tab", "Down", "Down", "Return"});
    waitForWindow("File: [Untitled]");
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

    auto edited = written;
    edited[1].replace(0, 7, "295,630");
    waitForWindow("File: [mine]", "ctrl+e");
    keys({"Home", "Tab", "Tab", "Tab", "BackSpace", "Tab"}); // nothing in X
    setup.signal(SIGSTOP); // a busy machine: keys don't overtake what the keys before them do
    fill("9999");
    keys({"alt+v", "ctrl+s", "alt+e", "Down", "Down", "alt+m", "d", "alt+v"});
    setup.signal(SIGCONT);
    expectFile(edited);
    edited[0] = "564|Tea for one|590x380|5|5|3";
    edited.erase(edited.begin() + 3);
    setup.signal(SIGSTOP);
    keys({"ctrl+e", "y"}); // the second one is for the question
    setup.signal(SIGCONT);
    waitForWindow(editor);
    expectFile(edited);
}

} // namespace

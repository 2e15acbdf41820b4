// While the machine is busy the user goes on. What he does then comes out as if it had not been.
#include "tests/program/editing.h"

#include <csignal>

namespace {

using namespace ground;

class Busy : public Editing {
  protected:
    Busy() {
        openFrameEditor();
        keys({"alt+t", "1", "alt+v", "ctrl+s"});
        ground.typeInto("Save Toon File", "mine.zkt");
        waitForWindow(mine);
    }

    /// All of it while the program stands still.
    void atOneGo(const std::vector<std::string>& pressed, std::optional<QPoint> clicked = {}) {
        setup.signal(SIGSTOP);
        keys(pressed);
        if (clicked) {
            click(*clicked);
        }
        setup.signal(SIGCONT);
    }

    static std::vector<std::string> fileOf(const std::string& caption, const std::string& frame) {
        return {"196|" + caption + "|590x380|1|3|1", frame};
    }

    static constexpr const char* named = "Fenky Dorbo's Rematch";
    static constexpr const char* mine = "File: [mine]";
    static constexpr const char* question = "Dorbo Toon Frame File";

    Process setup = ground.start({});
};

TEST_F(Busy, KeysAndClicksGoWhereTheyGoInAnIdleProgram) {
    expectFile(fileOf(named, "295,190 0 5 0 1"));
    atOneGo({"alt+t", "ctrl+a", "2", "alt+v", "alt+F4"});
    waitForWindow(question); // asked after the frame was kept
    keys({"Escape"});
    waitForWindow(mine);
    atOneGo({"ctrl+e", "Escape", "ctrl+s"});
    expectFile(fileOf(named, "295,190 0 5 0 2")); // the key behind the answer is the frame editor's
    atOneGo({"ctrl+g", "a", "b", "c", "Return", "ctrl+s"});
    expectFile(fileOf("abc", "295,190 0 5 0 2")); // the dialog gets what was meant for it
    keys({"ctrl+e"});
    waitForWindow(editor);
    atOneGo({"alt+f", "Escape", "ctrl+e"}); // the key behind the menu is the main window's
    waitForWindow(mine);
    keys({"alt+o"});
    waitForWindow(pickersTitle);
    keys({"4"});
    waitForWindow(mine);
    atOneGo({"ctrl+e"}, stage.topLeft() + QPoint(500, 300)); // a question lies over the stage
    waitForWindow(question);
    keys({"Escape"});
    waitForWindow(mine);
    keys({"alt+v", "ctrl+s"});
    expectFile(fileOf("abc", "295,190 3 5 0 2"));
}

} // namespace

// While poses can be picked the pointer stays over their pictures, on a real screen.
#include "tests/program/editing.h"

#include <csignal>

namespace {

using namespace ground;

class Confinement : public Editing {
  protected:
    Confinement() {
        openFrameEditor();
    }

    void openPicker() {
        keys({"alt+o"});
        waitForWindow(pickersTitle);
    }

    /// How far the pointer gets, by a leap to a corner and by a long stroke of the mouse.
    QRect reach() {
        ground.command({"xdotool", "mousemove", "0", "0"});
        const QPoint corner = ground.pointer();
        ground.command({"xdotool", "mousemove_relative", "--", "3000", "3000"});
        return {corner, ground.pointer()};
    }

    void expectReach(QRect expected, const char* when) {
        QRect got;
        EXPECT_TRUE(waitFor([&] { return (got = reach()) == expected; }, 5))
            << when << ": " << got.left() << "," << got.top() << " to " << got.right() << ","
            << got.bottom();
    }

    Process setup = ground.start({});
};

TEST_F(Confinement, LastsUntilAPick) {
    openPicker();
    expectReach(picker, "with the picker");
    keys({"3"});
    waitForWindow("File: [Untitled]");
    expectReach(screen, "after a pick");
    openPicker();
    expectReach(picker, "with the picker again");
    setup.signal(SIGTERM);
    EXPECT_EQ(setup.exitCode(), 255) << "ended by a signal";
    expectReach(screen, "after the end");
}

TEST_F(Confinement, WaitsForAnotherProgramThatHoldsThePointer) {
    ASSERT_TRUE(ground.takePointer());
    openPicker();
    expectReach(screen, "held by another program");
    ground.giveInputBack();
    ground.command({"xdotool", "mousemove", "300", "200", "mousemove_relative", "5", "5"});
    expectReach(picker, "when that has let go");
    setup.signal(SIGKILL);
    EXPECT_EQ(setup.exitCode(), -1) << "killed";
    expectReach(screen, "after the end");
}

} // namespace

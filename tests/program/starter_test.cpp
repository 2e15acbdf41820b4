// The saver under the programs that start one when nobody has touched the machine for a while.
#include "tests/program/run.h"

#include <csignal>

namespace {

using ground::Process;
using ground::Run;
using ground::waitFor;

class Starter : public Run {
  protected:
    bool endsOnAKey() {
        ground.press("a");
        return waitFor([&] { return ground.grab() == bare; });
    }
};

TEST_F(Starter, XAutoLockStartsItTimeAndAgain) {
    auto starter =
        ground.launch({"xautolock", "-time", "60", "-locker", DORBO_START " " DORBO_PROGRAM " S"});
    for (int turn = 0; turn < 2; ++turn) {
        // It takes no order until it is up, nor while a locker of its own runs.
        ASSERT_TRUE(waitFor([&] {
            return ground.command({"xautolock", "-locknow"}) == 0 &&
                   waitFor([&] { return ground.grab() != bare; }, 1);
        }));
        waitForSaver();
        EXPECT_TRUE(endsOnAKey()) << turn;
    }
    EXPECT_TRUE(setting("Directory").ends_with("\\data\\dorbo\\toons\\"));
    EXPECT_TRUE(starter.running());
    starter.signal(SIGTERM);
}

TEST_F(Starter, XssLockLetsTheMachineSleepOnceItIsUp) {
    auto bus = ground.launch({"dbus-daemon", "--session", "--nofork", "--print-address"});
    const std::string address = bus.readLine();
    const std::string system = "DBUS_SYSTEM_BUS_ADDRESS=" + address;
    auto logind = ground.launch(
        {"env", system, "/usr/bin/python3", DORBO_SOURCE_DIR "/tests/program/fake_logind.py"});
    ASSERT_EQ(logind.readLine(), "ready");
    auto starter = ground.launch({"env", system, "xss-lock", "-l", "--", DORBO_PROGRAM, "S"});
    ASSERT_EQ(logind.readLine(), "inhibited");
    ASSERT_EQ(logind.readLine(), "session") << "it aborts if it is told of a sleep before that";

    const QRgb corner = ground::loadPicture("bg01").pixel(0, 0);
    ASSERT_EQ(ground.command({"dbus-send", "--bus=" + address, "--print-reply",
                              "--dest=org.freedesktop.login1", "/org/freedesktop/login1",
                              "dorbo.Test.Sleep"}),
              0);
    EXPECT_EQ(logind.readLine(), "released");
    EXPECT_EQ(ground.grab().pixel(0, 0), corner) << "before the saver is up";
    EXPECT_TRUE(endsOnAKey());

    // The process of the first one may take a moment longer to end than its window.
    const auto startsAgain = [&] {
        ground.command({"sh", "-c", "xset s reset && xset s activate"});
        return waitFor([&] { return ground.grab().pixel(0, 0) == corner; }, 2);
    };
    ASSERT_TRUE(waitFor(startsAgain));
    EXPECT_TRUE(endsOnAKey());
    EXPECT_TRUE(starter.running());
    starter.signal(SIGTERM);
    EXPECT_EQ(starter.exitCode(), 0);
}

} // namespace

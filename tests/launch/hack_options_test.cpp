#include "launch/hack_options.h"

#include <gtest/gtest.h>

TEST(HackOptions, SayInWhichWindow) {
    using enum HackTarget;

    const struct {
        const char* variable;
        std::vector<std::string> arguments;
        HackTarget target;
        DWORD window;
    } cases[] = {
        {"0x1A00003", {}, WINDOW, 0x1A00003},
        {"27262979", {}, WINDOW, 27262979},
        {"0x1A00003", {"-root"}, WINDOW, 0x1A00003},
        {"0x1A00003", {"--root", "--window-id", "0x7"}, WINDOW, 7}, // as the settings preview does
        {"0x1A00003", {"-window-id", "7", "-root"}, WINDOW, 0x1A00003},
        {nullptr, {"-window-id", "0X1fffffff"}, WINDOW, 0x1FFFFFFF},
        {nullptr, {"--root"}, DESKTOP, 0},
        {nullptr, {"-window-id", "7", "-root"}, DESKTOP, 0},
        {nullptr, {}, NOWHERE, 0},
        // A host that has no window yet doesn't mean the root window.
        {"", {"-root"}, NOWHERE, 0},
        {"0", {}, NOWHERE, 0},
        {"-7", {}, NOWHERE, 0},
        {" 7", {}, NOWHERE, 0},
        {"7 ", {}, NOWHERE, 0},
        {"0x20000000", {}, NOWHERE, 0},
        {"99999999999999999999", {}, NOWHERE, 0},
        {"none", {"-window-id", "7"}, WINDOW, 7},
        {"7", {"-window-id"}, WRONG, 0},
        {"7", {"-window-id", "-root"}, WRONG, 0},
        {"7", {"-fps"}, WRONG, 0},
        {"7", {"---root"}, WRONG, 0},
        {"7", {"-fps", "--help"}, WRONG, 0},
        {nullptr, {"-root", "--help"}, HELP, 0},
    };

    for (const auto& one : cases) {
        const HackRequest request = ReadHackArguments(one.arguments, one.variable);
        const auto what = testing::PrintToString(one.arguments) +
                          (one.variable == nullptr ? " without" : one.variable);
        EXPECT_EQ(request.target, one.target) << what;
        EXPECT_EQ(request.window, one.window) << what;
        EXPECT_EQ(request.complaint.empty(),
                  one.target != HackTarget::NOWHERE && one.target != HackTarget::WRONG)
            << what;
    }
}

// The program `dorbo-hack`: the show inside a window of a program that hosts savers.
#include "launch/hack_options.h"
#include "launch/toon_home.h"
#include "platform/user.h"
#include "saver/saver_main.h"

#include <algorithm>
#include <csignal>
#include <cstdio>
#include <cstdlib>

constexpr int EXIT_NO_WINDOW = 1;
constexpr int EXIT_USAGE = 2;

static const char HELP[] =
    R"(usage: dorbo-hack [--root] [--window-id ID]

Dorbo's show, for programs that host screen savers. It shows itself in the window
whose id stands in XSCREENSAVER_WINDOW, or that an option names, and ends with it.

  --window-id ID   this window, in decimal or as 0x...
  --root           the window in XSCREENSAVER_WINDOW; without that variable the
                   root window, behind all other windows
  --help           this text

One minus sign will do for two. For the saver itself run: dorbo S
)";

static int Fail(int code, const std::string& why) {
    std::fprintf(stderr, "dorbo-hack: %s\n", why.c_str());
    return code;
}

static int ShowIn(const HackRequest& request) {
    const HWND desktop = GetDesktopWindow();
    if (!desktop) {
        return EXIT_NO_WINDOW; // there is no display, which has been said
    }
    const HWND host = request.target == HackTarget::DESKTOP ? desktop : HWND{request.window};
    if (!IsWindow(host)) {
        char id[16];
        std::snprintf(id, sizeof id, "0x%x", host.number);
        return Fail(EXIT_NO_WINDOW, "there is no window " + std::string(id));
    }
    EnterToonHome();
    return RunHostedShow(host) == 0 ? 0 : EXIT_NO_WINDOW;
}

int main(int count, char** words) {
    // A host that asks for a fresh start by it would end a program that doesn't know it.
    std::signal(SIGUSR1, SIG_IGN);
    const HackRequest request = ReadHackArguments({words + std::min(count, 1), words + count},
                                                  std::getenv("XSCREENSAVER_WINDOW"));
    switch (request.target) {
    case HackTarget::HELP:
        std::fputs(static_cast<const char*>(HELP), stdout);
        return 0;
    case HackTarget::WRONG:
        return Fail(EXIT_USAGE, request.complaint + "\nTry: dorbo-hack --help");
    case HackTarget::NOWHERE:
        return Fail(EXIT_NO_WINDOW, request.complaint);
    default:
        return ShowIn(request);
    }
}

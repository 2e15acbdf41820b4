#include "platform/user/ending.h"

#include "platform/kernel/descriptor.h"
#include "platform/user/queue.h"
#include "platform/user/window.h"

#include <QSocketNotifier>

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <unistd.h>
#include <vector>

namespace seam {

namespace {

int signalPipe = -1; // the end that the handler writes to

/// Only what may be called at any moment: one byte, which the loop reads when it comes round.
void onSignal(int /*number*/) {
    const int before = errno;
    const char byte = 0;
    [[maybe_unused]] const ssize_t written = write(signalPipe, &byte, 1);
    errno = before;
}

std::vector<HWND> topLevelWindows() {
    std::vector<HWND> found;
    forEachWindow([&](const Window& window) {
        if (!window.dying && findWindow(window.parent) == nullptr) {
            found.push_back(window.handle);
        }
    });
    return found;
}

void endProgram(int pipe) {
    std::array<char, 16> bytes{};
    while (read(pipe, bytes.data(), bytes.size()) > 0) {
    }
    for (const HWND window : topLevelWindows()) {
        queuePosted({window, WM_ENDSESSION, TRUE, 0, 0});
    }
    PostQuitMessage(0);
}

void catchSignal(int number) {
    struct sigaction action = {};
    sigaction(number, nullptr, &action);
    if (action.sa_handler != SIG_DFL) {
        return;
    }
    action = {};
    action.sa_handler = onSignal;
    action.sa_flags = SA_RESTART;
    sigaction(number, &action, nullptr);
}

/// The toolkit has closed its connection: what is sent to the windows only saves and frees.
void onExit() {
    for (const HWND handle : topLevelWindows()) {
        Window* window = findWindow(handle); // the end of one before may have been its own
        if (window != nullptr && !window->dying) {
            window->dying = true;
            SendMessageA(handle, WM_DESTROY, 0, 0);
        }
    }
}

} // namespace

void catchSignals() {
    std::array<int, 2> ends{};
    if (signalPipe >= 0 || pipe2(ends.data(), O_CLOEXEC | O_NONBLOCK) != 0) {
        return;
    }
    signalPipe = ends[1];
    const int reading = ends[0];
    // Kept, like the application object, until the process ends.
    auto* const notifier = new QSocketNotifier(reading, QSocketNotifier::Read);
    QObject::connect(notifier, &QSocketNotifier::activated, notifier,
                     [reading] { endProgram(reading); });
    for (const int number : {SIGTERM, SIGINT, SIGHUP}) {
        catchSignal(number);
    }
    std::signal(SIGPIPE, SIG_IGN); // a warning that nobody reads any more ends nothing
}

void endWindowsAtExit() {
    [[maybe_unused]] static const int registered = std::atexit(onExit);
}

} // namespace seam

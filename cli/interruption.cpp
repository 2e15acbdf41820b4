#include "cli/interruption.h"

#include <csignal>
#include <ctime>
#include <initializer_list>

static volatile std::sig_atomic_t caught = 0;
static volatile std::time_t caughtAt = 0;

/// Only what may be called at any moment.
static void onSignal(int signal) {
    constexpr std::time_t patience = 1; // seconds; it takes some milliseconds where nothing hangs
    const std::time_t now = std::time(nullptr);
    if (caught == 0) {
        caughtAt = now;
        caught = signal;
    } else if (now - caughtAt > patience) {
        EndBySignal(signal);
    }
}

void CatchInterruptions() {
    for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
        struct sigaction action = {};
        sigaction(signal, nullptr, &action);
        if (action.sa_handler != SIG_IGN) {
            action = {};
            action.sa_handler = onSignal;
            action.sa_flags = SA_RESTART;
            sigaction(signal, &action, nullptr);
        }
    }
    std::signal(SIGXFSZ, SIG_IGN);
}

int Interruption() {
    return caught;
}

int EndBySignal(int signal) {
    std::signal(signal, SIG_DFL);
    std::raise(signal);
    return 1;
}

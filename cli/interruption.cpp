#include "cli/interruption.h"

#include <csignal>
#include <initializer_list>

static volatile std::sig_atomic_t caught = 0;

static void onSignal(int signal) {
    caught = signal;
}

void CatchInterruptions() {
    for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
        struct sigaction action = {};
        sigaction(signal, nullptr, &action);
        if (action.sa_handler != SIG_IGN) {
            action = {};
            action.sa_handler = onSignal;
            action.sa_flags = SA_RESTART | static_cast<int>(SA_RESETHAND);
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

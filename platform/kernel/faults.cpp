#include "platform/kernel/faults.h"

#include "platform/harness.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <unistd.h>

namespace seam {

bool faultsWatched;

namespace {

constexpr std::size_t kinds = static_cast<std::size_t>(Operation::any) + 1;
constexpr std::size_t fewBytes = 40; // less than any record or settings file

struct Watch {
    Operation operation;
    std::size_t at; // counted from 1, 0 for none
    Fault fault;
    std::array<std::size_t, kinds> seen;
    bool nextKilled;
};

Watch watch;

std::size_t& seen(Operation operation) {
    return watch.seen.at(static_cast<std::size_t>(operation));
}

bool touchesFiles(Operation operation) {
    return operation != Operation::picture && operation != Operation::block;
}

int reasonOf(Operation operation) {
    if (!touchesFiles(operation)) {
        return ENOMEM;
    }
    return operation == Operation::write ? ENOSPC : EIO;
}

void lessen(std::size_t* bytes) {
    if (bytes != nullptr) {
        *bytes = std::min((*bytes + 1) / 2, fewBytes);
    }
}

/// What becomes of the chosen operation; true if it is refused.
bool strike(std::size_t* bytes) {
    switch (watch.fault) {
    case Fault::error:
    case Fault::onwards:
        return true;
    case Fault::killed:
        kill(getpid(), SIGKILL);
        return true;
    case Fault::halfKilled:
        watch.nextKilled = true;
        [[fallthrough]];
    case Fault::lessened:
    case Fault::cut:
        lessen(bytes);
        return false;
    }
    return false;
}

} // namespace

bool countOperation(Operation operation, std::size_t* bytes) {
    ++seen(operation);
    seen(Operation::any) += touchesFiles(operation) ? 1U : 0U;
    if (watch.nextKilled) {
        kill(getpid(), SIGKILL);
    }
    const bool chosen = watch.operation == operation ||
                        (watch.operation == Operation::any && touchesFiles(operation));
    if (!chosen || watch.at == 0) {
        return false;
    }
    const std::size_t number = seen(watch.operation);
    const bool behind = (watch.fault == Fault::cut && number == watch.at + 1) ||
                        (watch.fault == Fault::onwards && number > watch.at);
    const bool refused = number == watch.at ? strike(bytes) : behind;
    errno = refused ? reasonOf(operation) : errno;
    return refused;
}

void makeFault(Operation operation, std::size_t at, Fault fault) {
    watch = {operation, at, fault, {}, false};
    faultsWatched = true;
}

std::size_t operationsSeen(Operation operation) {
    return seen(operation);
}

void endFaults() {
    faultsWatched = false;
}

} // namespace seam

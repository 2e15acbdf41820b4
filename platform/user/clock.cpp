#include "platform/user/clock.h"

#include "platform/harness.h"
#include "platform/kernel.h"

#include <algorithm>
#include <chrono>
#include <ctime>

namespace seam {

namespace {

bool manual = false;
std::int64_t manualNow = 0;
DWORD manualStart = 0;

} // namespace

void useManualClock(DWORD seconds) {
    manual = true;
    manualNow = 0;
    manualStart = seconds;
}

void useSystemClock() {
    manual = false;
}

bool clockIsManual() {
    return manual;
}

void moveClock(std::int64_t milliseconds) {
    manualNow = std::max(manualNow, milliseconds);
}

std::int64_t clockNow() {
    if (manual) {
        return manualNow;
    }
    const auto now = std::chrono::steady_clock::now().time_since_epoch();
    return std::chrono::duration_cast<std::chrono::milliseconds>(now).count();
}

} // namespace seam

DWORD WallClockSeconds() {
    if (seam::clockIsManual()) {
        return seam::manualStart + static_cast<DWORD>(seam::clockNow() / 1000);
    }
    return static_cast<DWORD>(std::time(nullptr));
}

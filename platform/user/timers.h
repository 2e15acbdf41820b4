// The timers of all windows.
#pragma once

#include "platform/user.h"

#include <cstdint>
#include <optional>

namespace seam {

/// The timer that has waited longest, if one is due now and its window and id fit the filters.
struct DueTimer {
    HWND window;
    UINT_PTR id;
};

std::optional<DueTimer> dueTimer(HWND window, bool anyWindow);

/// Takes note that the timer has come; sets when it is due again.
void timerTaken(const DueTimer& timer);

void killTimersOf(HWND window);

std::size_t liveTimers();

/// Adds to the record of a show that a timer's message is being handed over.
void traceTick(UINT_PTR id);

} // namespace seam

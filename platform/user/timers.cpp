#include "platform/user/timers.h"

#include "platform/harness.h"
#include "platform/trace.h"
#include "platform/user/queue.h"
#include "platform/user/window.h"

#include <algorithm>
#include <string>
#include <tuple>
#include <vector>

namespace seam {

namespace {

struct Timer {
    HWND window;
    UINT_PTR id;
    std::int64_t interval;
    std::int64_t due;
    std::uint64_t order; // which was set first, where two are due at once
};

std::vector<Timer> timers;
std::uint64_t timersSet = 0;

std::vector<Timer>::iterator findTimer(HWND window, UINT_PTR id) {
    return std::find_if(timers.begin(), timers.end(), [&](const Timer& timer) {
        return timer.window == window && timer.id == id;
    });
}

bool comesFirst(const Timer& left, const Timer& right) {
    return std::tie(left.due, left.order) < std::tie(right.due, right.order);
}

/// The timer as the record of a show tells of it.
std::string traceName(UINT_PTR id) {
    const char* name = TraceTimerName == nullptr ? nullptr : TraceTimerName(id);
    return name == nullptr ? std::to_string(id) : name;
}

void traceSet(UINT_PTR id, std::int64_t interval) {
    if (TraceSink != nullptr) {
        Trace("timer_set timer=%s id=%zu ms=%lld", traceName(id).c_str(), std::size_t{id},
              static_cast<long long>(interval));
    }
}

void traceKill(UINT_PTR id, bool wasSet) {
    if (TraceSink != nullptr) {
        Trace("timer_kill timer=%s id=%zu was_set=%d", traceName(id).c_str(), std::size_t{id},
              wasSet ? 1 : 0);
    }
}

} // namespace

std::optional<std::int64_t> nextDeadline() {
    const auto first = std::min_element(timers.begin(), timers.end(), comesFirst);
    return first == timers.end() ? std::nullopt : std::optional(first->due);
}

std::optional<DueTimer> dueTimer(HWND window, bool anyWindow) {
    const std::int64_t now = clockNow();
    const Timer* first = nullptr;
    for (const Timer& timer : timers) {
        if (timer.due <= now && (anyWindow || timer.window == window) &&
            (first == nullptr || comesFirst(timer, *first))) {
            first = &timer;
        }
    }
    return first == nullptr ? std::nullopt : std::optional(DueTimer{first->window, first->id});
}

void timerTaken(const DueTimer& timer) {
    const auto found = findTimer(timer.window, timer.id);
    if (found == timers.end()) {
        return;
    }
    // One tick however late: the ticks that were missed are not made up for.
    const std::int64_t now = clockNow();
    found->due += found->interval;
    if (found->due <= now) {
        found->due = now + found->interval;
    }
}

void killTimersOf(HWND window) {
    std::erase_if(timers, [window](const Timer& timer) { return timer.window == window; });
}

std::size_t liveTimers() {
    return timers.size();
}

void traceTick(UINT_PTR id) {
    if (TraceSink != nullptr) {
        Trace("tick timer=%s", traceName(id).c_str());
    }
}

} // namespace seam

using namespace seam;

UINT_PTR SetTimer(HWND window, UINT_PTR timer, UINT milliseconds, TIMERPROC procedure) {
    if (findWindow(window) == nullptr || procedure != nullptr) {
        return 0;
    }
    const std::int64_t interval = std::clamp<std::int64_t>(milliseconds, 1, 0x7FFFFFFF);
    const auto found = findTimer(window, timer);
    const Timer set{window, timer, interval, clockNow() + interval, ++timersSet};
    if (found == timers.end()) {
        timers.push_back(set);
    } else {
        *found = set;
    }
    traceSet(timer, interval);
    wake();
    // The result says that it runs; a timer of id 0 runs as well as any other.
    return timer == 0 ? 1 : timer;
}

BOOL KillTimer(HWND window, UINT_PTR timer) {
    const auto found = findTimer(window, timer);
    const bool wasSet = found != timers.end();
    if (wasSet) {
        timers.erase(found);
    }
    traceKill(timer, wasSet);
    return wasSet ? TRUE : FALSE;
}

#include "cli/progress.h"

#include <algorithm>
#include <cstdio>
#include <unistd.h>
#include <utility>

Progress::Progress(std::string what, std::int64_t whole)
    : what_(std::move(what)), whole_(std::max<std::int64_t>(whole, 1)),
      onTerminal_(isatty(STDERR_FILENO) != 0) {}

Progress::~Progress() {
    if (shown_) {
        std::fputs("\r\033[K", stderr);
    }
}

void Progress::show(std::int64_t done) {
    constexpr std::chrono::milliseconds interval(100);
    constexpr std::int64_t width = 40;
    const Clock::time_point now = Clock::now();
    if (!onTerminal_ || now < next_) {
        return;
    }
    next_ = now + interval;
    shown_ = true;
    done = std::clamp<std::int64_t>(done, 0, whole_);
    std::string bar(static_cast<std::size_t>(width * done / whole_), '#');
    bar.resize(width, '.');
    std::fprintf(stderr, "\r%s [%s] %3d %%", what_.c_str(), bar.c_str(),
                 static_cast<int>(100 * done / whole_));
}

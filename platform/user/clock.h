// The clock that timers run on: the system's, or one that is moved by hand.
#pragma once

#include <cstdint>

namespace seam {

/// Whether time stands still until it is moved.
bool clockIsManual();

/// Moves the clock that is moved by hand forward to `milliseconds`; never back.
void moveClock(std::int64_t milliseconds);

} // namespace seam

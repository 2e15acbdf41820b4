// What the process holds at a moment.
#pragma once

#include "platform/harness.h"

#include <cstddef>

struct Holdings {
    std::size_t heap = 0; // bytes that somebody has asked for and not given back
    std::size_t files = 0;
    std::size_t resident = 0; // KiB
    seam::HandleCounts handles;
};

Holdings HoldingsNow();

/// Of all kinds together.
std::size_t HandlesOf(const Holdings& holdings);

// Answers of the X server, which whoever asks has to free.
#pragma once

#include <cstdlib>
#include <memory>

namespace seam {

/// Takes an answer over; null stays null, where the server gave none.
template <class Reply>
std::unique_ptr<Reply, decltype(&std::free)> own(Reply* reply) {
    return {reply, &std::free};
}

} // namespace seam

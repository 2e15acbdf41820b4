// A run with each of its operations failing in turn.
#pragma once

#include "platform/harness.h"

#include <gtest/gtest.h>

#include <functional>
#include <initializer_list>
#include <set>
#include <string>

/// The fault of one run.
struct ChosenFault {
    seam::Operation operation;
    std::size_t at; // 0 for none
    seam::Fault fault;

    void begin() const {
        seam::makeFault(operation, at, fault);
    }
};

using Outcomes = std::set<std::string>;

/// Runs once with nothing failing, which tells how many operations of the kind there are, and then
/// with each of them failing in each of the ways, of those that it can fail in. `run` calls begin()
/// and endFaults() round what is tried and gives what has come of it. Gives all that has come of
/// it.
inline Outcomes eachFault(seam::Operation operation, std::initializer_list<seam::Fault> faults,
                          const std::function<std::string(const ChosenFault&)>& run) {
    Outcomes outcomes{run({operation, 0, seam::Fault::error})};
    const std::size_t count = seam::operationsSeen(operation);
    EXPECT_GT(count, 0U) << "nothing that could fail";
    const bool moves = operation == seam::Operation::read || operation == seam::Operation::write;
    for (const seam::Fault fault : faults) {
        if (!moves && (fault == seam::Fault::lessened || fault == seam::Fault::cut)) {
            continue;
        }
        for (std::size_t at = 1; at <= count && !testing::Test::HasFailure(); ++at) {
            SCOPED_TRACE(testing::Message()
                         << "operation " << static_cast<int>(operation) << ", number " << at
                         << " of " << count << ", fault " << static_cast<int>(fault));
            outcomes.insert(run({operation, at, fault}));
            EXPECT_GE(seam::operationsSeen(operation), at) << "it never came";
        }
    }
    return outcomes;
}

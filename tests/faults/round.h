/// \file
/// What has to hold after a round in which something fails.

#ifndef TESTS_FAULTS_ROUND_H
#define TESTS_FAULTS_ROUND_H

#include "tests/faults/scenario.h"

#include <cstdint>
#include <map>
#include <string>
#include <string_view>

/// A lock that the platform layer does not give back stays held, and whoever takes it waits.
inline constexpr std::string_view LEFT_OUT = "xos_SemGive";

/// How often a scenario runs with a fault. What is kept for later uses may grow now and then; what is lost grows every
/// time.
inline constexpr int RUNS = 7;
inline constexpr int RUNS_TO_GROW = 5;

/// Every path below a folder with the content of its file; "/" for a folder.
using Snapshot = std::map<std::string, std::string>;

Snapshot snapshotOf(std::string const& folder);

/// Compares the content of a folder with what it was before and with what it is after a run without faults.
/// \return what does not hold; empty: nothing
std::string brokenPromise(Scenario::Promise promise, bool succeeded, bool canLeaveTemporary, Snapshot const& before,
                          Snapshot const& after, Snapshot const& now);

/// Tells whether a count grows from run to run.
class Growth {
public:
    explicit Growth(std::int64_t (*count)()) : count_(count) {}

    void look();
    bool isSteady() const { return times_ >= RUNS_TO_GROW; }

private:
    std::int64_t (*const count_)();
    std::int64_t last_ = 0;
    int times_ = 0;
};

Scenarios allScenarios();

#endif

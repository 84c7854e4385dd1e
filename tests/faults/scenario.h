/// \file
/// The scenarios in which calls and allocations are made to fail: at least one for every public operation.

#ifndef TESTS_FAULTS_SCENARIO_H
#define TESTS_FAULTS_SCENARIO_H

#include "tests/support/scratch.h"

#include <string>
#include <vector>

/// The folder of a round.
struct Place {
    std::string path;
    std::string operator/(std::string const& name) const { return path + "/" + name; }
};

struct Scenario {
    enum Promise {
        /// A file that is left has the content that it had, or the one that it is to have.
        WHOLE_FILES,
        /// A file may also be cut: it is written piece by piece.
        PIECES,
        /// As WHOLE_FILES; success says nothing of what is not there: what cannot be listed counts as empty.
        WHAT_IS_LISTED,
        /// Files have contents of their own in every run.
        NAMES
    };

    enum Without {
        NONE,
        /// The operation tries until it succeeds.
        LASTING_FAULTS,
        /// The system's own library crashes or loses memory when an allocation fails.
        ALLOCATION_FAULTS
    };

    char const* name;
    /// Makes what the operation needs; nothing fails meanwhile.
    void (*prepare)(Place const& place);
    /// \return whether the operation says that it succeeded, with what it is to give
    bool (*act)(Place const& place);
    Promise promise = WHOLE_FILES;
    Without without = NONE;
};

using Scenarios = std::vector<Scenario>;

Scenarios textScenarios();
Scenarios fileScenarios();
Scenarios walkScenarios();
Scenarios storeScenarios();
Scenarios systemScenarios();
Scenarios threadScenarios();

inline void prepareNothing(Place const&) {}

/// Two files, one of which is long, a folder with two levels, and an empty one.
inline void prepareTree(Place const& place) {
    put(place / "a", "small");
    put(place / "b", std::string(100'000, 'b'));
    makeFolder(place / "d/e");
    put(place / "d/c", "in a folder");
    put(place / "d/e/f", std::string(70'000, 'f'));
    makeFolder(place / "empty");
}

#endif

/// \file
/// Processes that write until they are killed, and what must hold of their files then.

#ifndef TESTS_STRESS_WRITERS_H
#define TESTS_STRESS_WRITERS_H

#include "tests/stress/campaign.h"

#include <string>
#include <vector>

namespace stress {

/// Where a writer writes.
struct Desk {
    std::string folder;
    /// A folder of another file system, where the system has two.
    std::string elsewhere;
    /// Of each of the two contents.
    std::uint64_t size;

    std::string operator/(std::string const& name) const { return folder + "/" + name; }
};

struct Writer {
    char const* name;
    void (*prepare)(Desk const& desk);
    /// Does the same again and again. \return whether one more round succeeded
    bool (*writeOnce)(Desk const& desk, std::uint64_t round);
    /// \return what does not hold; empty: nothing
    std::string (*complaint)(Desk const& desk);
};

std::vector<Writer> const& writers();

/// One of the two contents between which writers change.
std::string content(Desk const& desk, std::uint64_t round);

} // namespace stress

#endif

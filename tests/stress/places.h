/// \file
/// What campaigns know of the system and of their processes. Twins: places_posix.cpp, places_win.cpp.

#ifndef TESTS_STRESS_PLACES_H
#define TESTS_STRESS_PLACES_H

#include <cstdint>
#include <filesystem>
#include <string>

namespace stress {

/// A folder for very many files: in memory, where there is one.
std::filesystem::path stressFolder();

/// What the process has.
struct Holdings {
    std::uint64_t handles;
    std::uint64_t threads;
    /// Mapped regions of memory.
    std::uint64_t mappings;
};
Holdings holdings();

/// The three counts, with spaces between them.
inline std::string countsOf(Holdings const& held) {
    return std::to_string(held.handles) + " " + std::to_string(held.threads) + " " + std::to_string(held.mappings);
}

/// Whether there is nothing that becomes more with every one of many rounds. What is kept for later uses may come and
/// go.
inline bool isSteady(Holdings const& early, Holdings const& late) {
    constexpr std::uint64_t SLACK = 8;
    return late.handles <= early.handles + SLACK && late.threads <= early.threads + SLACK &&
           late.mappings <= early.mappings + 4 * SLACK;
}

} // namespace stress

#endif

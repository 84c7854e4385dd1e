/// \file
/// Counts the allocations of the whole process and makes them fail. Whatever allocates goes through it: the library,
/// the runtime libraries, and texts that the system's library copies.

#ifndef TESTS_FAULTS_ALLOCATIONS_POSIX_H
#define TESTS_FAULTS_ALLOCATIONS_POSIX_H

#include <cstdint>

namespace allocations {

/// Starts counting from 0; the allocation with the number `first` and `times` - 1 behind it fail.
void failFrom(std::uint64_t first, std::uint64_t times);
/// Nothing fails any more.
/// \return how many have been made since `failFrom`
std::uint64_t stopFailing();
/// How many of them failed.
std::uint64_t failures();
/// Blocks that are allocated now.
std::int64_t living();

} // namespace allocations

#endif

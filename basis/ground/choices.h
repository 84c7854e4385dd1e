/// \file
/// Names for boolean arguments, for calls that would not read aloud with a bare `true` or `false`.

#ifndef BASIS_GROUND_CHOICES_H
#define BASIS_GROUND_CHOICES_H

namespace ZOR_Basis {

/// \name Files and directories
/// @{
inline constexpr bool OVERWRITING = true;
inline constexpr bool WITH_PARENTS = true;
inline constexpr bool WITHOUT_PARENTS = false;
inline constexpr bool WITH_CONTENTS = true;
inline constexpr bool WITHOUT_SECOND_FLAG = false;
/// Leaves out the platform layer's flag 0x40.
inline constexpr bool WITHOUT_CREATE_FLAG = true;
/// @}

/// \name Paths
/// @{
inline constexpr bool WITH_DOT = true;
inline constexpr bool WITHOUT_DOT = false;
inline constexpr bool NOT_A_URL = false;
/// @}

/// \name Walks
/// @{
inline constexpr bool DEEP = true;
inline constexpr bool ONE_LEVEL = false;
inline constexpr bool IGNORING_FAILURES = false;
inline constexpr bool WITH_WILDCARD = true;
inline constexpr bool WITHOUT_WILDCARD = false;
inline constexpr bool IN_ANY_CASE = true;
inline constexpr bool IN_EXACT_CASE = false;
/// @}

/// \name Blobs
/// @{
inline constexpr bool KEEPING_BYTES = true;
inline constexpr bool DISCARDING_BYTES = false;
/// @}

/// \name Timers
/// @{
inline constexpr bool STARTED = true;
inline constexpr bool NOT_SUSPENDED = false;
inline constexpr bool FOR_ONE_THREAD = false;
inline constexpr bool FOR_THREADS = true;
inline constexpr bool WITH_CHECKS = true;
/// @}

/// \name Locks
/// @{
inline constexpr bool UNLOCKED = false;
/// @}

/// \name Users and domains
/// @{
inline constexpr bool OF_THE_THREAD = false;
inline constexpr bool OF_THE_COMPUTER = false;
/// @}

} // namespace ZOR_Basis

#endif

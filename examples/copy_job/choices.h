/// \file
/// Names for the boolean arguments of the library's functions, so that the calls read aloud.

#ifndef EXAMPLES_COPY_JOB_CHOICES_H
#define EXAMPLES_COPY_JOB_CHOICES_H

inline constexpr bool WITH_PARENTS = true;
inline constexpr bool WITHOUT_PARENTS = false;
inline constexpr bool OVERWRITING = true;
inline constexpr bool WITH_CONTENTS = true;
inline constexpr bool WITHOUT_SECOND_FLAG = false;
inline constexpr bool DEEP = true;
inline constexpr bool ONE_LEVEL = false;
inline constexpr bool FIRST_ONLY = true;
inline constexpr bool LAST_OF_ALL = false;
inline constexpr bool STOPPING_ON_FAILURE = true;
inline constexpr bool IGNORING_FAILURES = false;
inline constexpr bool PLAIN_STORE = false;
inline constexpr bool FOR_ONE_THREAD = false;
inline constexpr bool STARTED = true;
inline constexpr bool NOT_SUSPENDED = false;
inline constexpr bool PRINTED = true;

#endif

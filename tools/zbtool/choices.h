/// \file
/// Names for the boolean arguments of the library's functions, so that the calls read aloud.

#ifndef TOOLS_ZBTOOL_CHOICES_H
#define TOOLS_ZBTOOL_CHOICES_H

namespace zbtool {

inline constexpr bool WITH_PARENTS = true;
inline constexpr bool WITHOUT_PARENTS = false;
inline constexpr bool OVERWRITING = true;
inline constexpr bool SPARING = false;
inline constexpr bool WITH_CONTENTS = true;
inline constexpr bool WITHOUT_CONTENTS = false;
inline constexpr bool WITHOUT_FIRST_FLAG = false;
inline constexpr bool WITHOUT_SECOND_FLAG = false;
inline constexpr bool WITHOUT_WILDCARD = false;
inline constexpr bool SYSTEM_ONLY = false;

} // namespace zbtool

#endif

/// \file
/// The flags that are handed to the platform layer's operations on entries.

#ifndef BASIS_FILES_PLATFORM_FLAGS_H
#define BASIS_FILES_PLATFORM_FLAGS_H

#include <cstdint>

namespace ZOR_Basis {

inline constexpr std::uint32_t OVERWRITE = 0x001;
inline constexpr std::uint32_t RECURSIVE = 0x200;
/// Goes with every removal that the library makes of its own.
inline constexpr std::uint32_t REMOVE_ALWAYS = 0x400;
inline constexpr std::uint32_t SECOND_FLAG = 0x800;

constexpr std::uint32_t flagIf(bool condition, std::uint32_t flag) { return condition ? flag : 0; }

} // namespace ZOR_Basis

#endif

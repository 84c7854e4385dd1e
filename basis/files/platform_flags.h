/// \file
/// The flags that the library passes to the platform layer.

#ifndef BASIS_FILES_PLATFORM_FLAGS_H
#define BASIS_FILES_PLATFORM_FLAGS_H

#include <cstdint>

namespace ZOR_Basis {

/// \name `xos_FileOpen`
/// @{
inline constexpr std::uint32_t OPEN_TRUNCATES = 0x01;
inline constexpr std::uint32_t OPEN_READS = 0x02;
inline constexpr std::uint32_t OPEN_APPENDS = 0x08;
/// Two flags, which go together: write, and create what does not exist.
inline constexpr std::uint32_t OPEN_WRITES = 0x14;
inline constexpr std::uint32_t OPEN_CREATES = 0x40;
/// Also `xos_DirOpenEx`: the entries of the encrypted store.
inline constexpr std::uint32_t ENCRYPTED_STORE = 0x4000000;
/// @}

/// \name `xos_FileStatByNameEx`, `xos_DirNextEx`
/// @{
inline constexpr std::uint32_t NAMES_AS_STORED = 0x4000;
/// @}

/// \name Copying, moving and removing
/// @{
inline constexpr std::uint32_t OVERWRITE = 0x001;
inline constexpr std::uint32_t RECURSIVE = 0x200;
/// The library passes it with every removal of its own.
inline constexpr std::uint32_t REMOVE_ALWAYS = 0x400;
inline constexpr std::uint32_t SECOND_FLAG = 0x800;
/// @}

/// The whole argument of `xos_FileCopy` and `xos_FileMove`, which take no flags.
constexpr int overwriteIf(bool condition) { return condition ? 1 : 0; }

constexpr std::uint32_t flagIf(bool condition, std::uint32_t flag) { return condition ? flag : 0; }

} // namespace ZOR_Basis

#endif

/// \file
/// Tells which kinds of variable-data input the configuration group "vdp" switches on.

#ifndef BASIS_SYSTEM_MODE_FLAGS_H
#define BASIS_SYSTEM_MODE_FLAGS_H

#include <cstdint>

namespace ZOR_Basis::ModeFlags {

enum Mode : std::uint32_t { VPS = 1, QDB = 2, VIPP = 4, PPML = 8, ALL = 15 };

/// Reads the configuration, again if it has been read before.
void load();
/// Whether it has been read.
bool isLoaded();
/// Whether any of the modes is on, as far as is known by now.
bool isOn(Mode modes);

} // namespace ZOR_Basis::ModeFlags

#endif

/// \file
/// What calls of the registry are offered, where they want more room than there is.

#ifndef TESTS_SYSTEM_WANTED_ROOM_WIN_H
#define TESTS_SYSTEM_WANTED_ROOM_WIN_H

#include "basis/platform/windows_api_win.h"

#include <utility>
#include <vector>

/// Whether a call reports the room that it wants.
inline bool reports;
inline std::vector<std::pair<DWORD, DWORD>> rooms;

#endif

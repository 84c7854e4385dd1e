/// \file
/// The one place from which the library includes the Windows interface.

#ifndef BASIS_PLATFORM_WINDOWS_API_WIN_H
#define BASIS_PLATFORM_WINDOWS_API_WIN_H

#ifndef WIN32_LEAN_AND_MEAN
#define WIN32_LEAN_AND_MEAN
#endif
#ifndef NOMINMAX
#define NOMINMAX
#endif

#include <windows.h>

// Macros that would rename functions and constants of our own.
#undef CopyFile
#undef GetCurrentTime
#undef GetObject
#undef MoveFile
#undef Yield
#undef near
#undef far

#endif

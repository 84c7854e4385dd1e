/// \file
/// The one place of host/ that includes `windows.h`; included by `_win` sources only.

#ifndef HOST_WINDOWS_API_H
#define HOST_WINDOWS_API_H

#ifndef WIN32_LEAN_AND_MEAN
#define WIN32_LEAN_AND_MEAN
#endif
#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>

#undef interface
#undef small
#undef near
#undef far
#undef CreateFile
#undef CopyFile
#undef MoveFile
#undef DeleteFile
#undef CreateDirectory
#undef RemoveDirectory

#endif

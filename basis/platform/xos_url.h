/// \file
/// Module `xos_url`: fetches the resource that a URL names. Valid C.

#ifndef BASIS_PLATFORM_XOS_URL_H
#define BASIS_PLATFORM_XOS_URL_H

#include "basis/platform/platform_api.h"

ZB_PLATFORM_C_BEGIN

/// Fetches `url` into the file `target`, completely or not at all: the bytes go into a file beside it, which is renamed
/// at the end. An existing file is replaced.
///
/// Stand-alone: `http`, `https` and `file` URLs. Up to 10 redirects are followed, to `http` and `https` only. `file`
/// URLs name regular files of this machine, on Windows also `file://server/share/...`. Blanks and bytes above 126 in a
/// URL count as their percent escapes. Proxies are the system's.
/// \param first  the user name for the server that `url` names, or null; no other server gets it
/// \param second  the password, or null
/// \return 0 when the server answered with success (200 to 299) and the body arrived and could be stored
/// \error an unknown scheme, no response within 30 s, any other status, a connection that is silent for 60 s, a body
///     shorter than announced, a target that cannot be written. If no length is announced and the connection is lost,
///     WinHTTP takes the bytes received so far for the whole body. The last error says which failure it was,
///     stand-alone as listed in docs/reasons.md
/// \thread any thread; the calling thread waits
/// \cost constant memory, whatever the length
XOS_API int xos_URLGet(char const* url, char const* target, char const* first, char const* second);

ZB_PLATFORM_C_END

#endif

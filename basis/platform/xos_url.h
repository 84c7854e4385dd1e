/// \file
/// Module `xos_url`: fetches what a URL names. C-clean.

#ifndef BASIS_PLATFORM_XOS_URL_H
#define BASIS_PLATFORM_XOS_URL_H

#include "basis/platform/platform_api.h"

ZB_PLATFORM_C_BEGIN

/// Fetches `url` into the file `target`. `first` and `second` are the user name and the password, or null.
/// \return 0 for success
XOS_API int xos_URLGet(char const* url, char const* target, char const* first, char const* second);

ZB_PLATFORM_C_END

#endif

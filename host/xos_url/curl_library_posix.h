/// \file
/// libcurl, loaded when it is first needed: it brings thirty libraries along, whose loading costs every process five
/// milliseconds, and few processes fetch anything.

#ifndef HOST_XOS_URL_CURL_LIBRARY_POSIX_H
#define HOST_XOS_URL_CURL_LIBRARY_POSIX_H

#include <curl/curl.h>

namespace host {

/// The functions of the library, under their own names without "curl_".
struct CurlLibrary {
    decltype(&curl_global_init) globalInit;
    decltype(&curl_easy_init) easyInit;
    decltype(&curl_easy_setopt) easySetopt;
    decltype(&curl_easy_perform) easyPerform;
    decltype(&curl_easy_getinfo) easyGetinfo;
    decltype(&curl_easy_cleanup) easyCleanup;
};

/// The library, which stays loaded.
/// \return null if it cannot be loaded or started; the next call tries again
CurlLibrary const* curlLibrary();

} // namespace host

#endif

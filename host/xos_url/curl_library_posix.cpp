#include "host/xos_url/curl_library_posix.h"

#include <dlfcn.h>
#include <mutex>

namespace host {

namespace {

/// The name that the library has had since its present interface began.
constexpr char NAME[] = "libcurl.so.4";

template <class Call>
bool find(void* library, char const* name, Call& call) {
    call = reinterpret_cast<Call>(::dlsym(library, name));
    return call != nullptr;
}

bool findAll(void* library, CurlLibrary& calls) {
    return find(library, "curl_global_init", calls.globalInit) && find(library, "curl_easy_init", calls.easyInit) &&
           find(library, "curl_easy_setopt", calls.easySetopt) &&
           find(library, "curl_easy_perform", calls.easyPerform) &&
           find(library, "curl_easy_getinfo", calls.easyGetinfo) &&
           find(library, "curl_easy_cleanup", calls.easyCleanup);
}

bool load(CurlLibrary& calls) {
    void* const library = ::dlopen(NAME, RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    return library != nullptr && findAll(library, calls) && calls.globalInit(CURL_GLOBAL_DEFAULT) == CURLE_OK;
}

} // namespace

CurlLibrary const* curlLibrary() {
    static constinit std::mutex mutex;
    static constinit CurlLibrary calls{};
    static constinit bool isReady = false;
    std::lock_guard const lock{mutex};
    if (!isReady) isReady = load(calls);
    return isReady ? &calls : nullptr;
}

} // namespace host

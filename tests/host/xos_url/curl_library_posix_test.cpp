#include "host/xos_url/curl_library_posix.h"

#include "host/xos_url/fetch.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <thread>

namespace {

bool isMissing = false;

struct NoSink : host::BodySink {
    bool take(void const*, std::size_t) override { return false; }
};

bool isLoaded() { return ::dlopen("libcurl.so.4", RTLD_NOW | RTLD_NOLOAD) != nullptr; }

int errorOfFetch() {
    NoSink sink;
    errno = 0;
    return host::fetch({"http://127.0.0.1:1/page", nullptr, nullptr, 1, 1}, sink) ? 0 : errno;
}

/// \return 0, or the number of the step that went wrong
int firstFetches() {
    if (isLoaded()) return 1;
    isMissing = true;
    if (errorOfFetch() != ELIBACC || host::curlLibrary() != nullptr) return 2;
    isMissing = false;
    if (errorOfFetch() != ECONNREFUSED || !isLoaded()) return 3;
    isMissing = true;
    return host::curlLibrary() != nullptr ? 0 : 4;
}

} // namespace

/// The program's own, which comes before that of the system.
extern "C" __attribute__((visibility("default"))) void* dlopen(char const* name, int mode) noexcept {
    if (isMissing && name != nullptr && std::strcmp(name, "libcurl.so.4") == 0) return nullptr;
    static auto* const next = reinterpret_cast<void* (*)(char const*, int)>(::dlsym(RTLD_NEXT, "dlopen"));
    return next(name, mode);
}

TEST(HostCurlLibraryPosix, is_loaded_when_it_is_needed_and_asked_for_again_if_it_was_missing) {
    // In a process of its own, as this one may have loaded it already.
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(std::exit(firstFetches()), testing::ExitedWithCode(0), "");
}

TEST(HostCurlLibraryPosix, is_loaded_once_for_all_threads) {
    host::CurlLibrary const* seen[8] = {};
    std::thread threads[8];
    for (int i = 0; i < 8; ++i) threads[i] = std::thread([&seen, i] { seen[i] = host::curlLibrary(); });
    for (std::thread& thread : threads) thread.join();
    for (auto const* library : seen) EXPECT_EQ(library, host::curlLibrary());
}

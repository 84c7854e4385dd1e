// The functions of directories and of their listing.

#include "basis/ground/wildcard.h"
#include "basis/platform/xos_basics.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/directories/raw_listing.h"
#include "host/xos_basics/directories/tree.h"
#include "host/xos_basics/result.h"

#include <cstring>
#include <string>

using host::FAILED;
using host::failsNow;
using host::Function;
using host::given;
using host::resultOf;

namespace {

constexpr std::uint32_t OVERWRITE = 0x001;
constexpr std::uint32_t RECURSIVE = 0x200;

/// What an `xos_Dir` stands for.
struct Listing {
    std::unique_ptr<host::RawListing> entries;
    /// Empty: every name.
    std::string pattern;
    bool anyCase = false;

    bool accepts(char const* name) const {
        if (pattern.empty()) return true;
        std::size_t const length = std::strlen(name);
        return anyCase ? ZOR_Basis::matchesWildcard<ZOR_Basis::AnyCase>(pattern.data(), pattern.size(), name, length)
                       : ZOR_Basis::matchesWildcard(pattern.data(), pattern.size(), name, length);
    }
};

enum Kind { ALL, DIRECTORIES, FILES };

/// Null, with the last error set, for the handle 0.
Listing* listingOf(xos_Dir handle) {
    if (handle == 0) host::setLastError(host::Error::BAD_HANDLE);
    return reinterpret_cast<Listing*>(static_cast<std::uintptr_t>(handle));
}

} // namespace

int xos_DirCreateEx(char const* path, int reserved) {
    if (failsNow(Function::xos_DirCreateEx, path, reserved) || !given(path)) return FAILED;
    return resultOf([&] { return host::createDirectory(path); });
}

int xos_DirRemove(char const* path, uint32_t flags) {
    if (failsNow(Function::xos_DirRemove, path, flags) || !given(path)) return FAILED;
    return resultOf([&] { return host::removeDirectory(path, (flags & RECURSIVE) != 0); });
}

int xos_DirCopy(char const* dst, char const* src, uint32_t flags) {
    if (failsNow(Function::xos_DirCopy, dst, src, flags) || !given(dst, src)) return FAILED;
    return resultOf([&] { return host::copyDirectory(dst, src, (flags & OVERWRITE) != 0, (flags & RECURSIVE) != 0); });
}

int xos_DirMove(char const* dst, char const* src, uint32_t flags) {
    if (failsNow(Function::xos_DirMove, dst, src, flags) || !given(dst, src)) return FAILED;
    return resultOf([&] { return host::moveDirectory(dst, src, (flags & OVERWRITE) != 0); });
}

xos_Dir xos_DirOpenEx(char const* path, char const* pattern, uint32_t flags) {
    if (failsNow(Function::xos_DirOpenEx, path, pattern, flags) || !given(path)) return 0;
    return host::unlessMemoryLacks(xos_Dir{0}, [&]() -> xos_Dir {
        auto listing = std::make_unique<Listing>();
        listing->entries = host::RawListing::open(path);
        if (listing->entries == nullptr) return 0;
        if (pattern != nullptr) listing->pattern = pattern;
        return reinterpret_cast<std::uintptr_t>(listing.release());
    });
}

void xos_DirForceCaseAny(xos_Dir handle, int on) {
    failsNow(Function::xos_DirForceCaseAny, handle, on);
    if (Listing* const listing = listingOf(handle)) listing->anyCase = on != 0;
}

char const* xos_DirNextEx(xos_Dir handle, int kind, int reserved, uint32_t flags) {
    if (failsNow(Function::xos_DirNextEx, handle, kind, reserved, flags)) return nullptr;
    Listing* const listing = listingOf(handle);
    if (listing == nullptr) return nullptr;
    if (kind < ALL || kind > FILES) {
        host::setLastError(host::Error::BAD_ARGUMENT);
        return nullptr;
    }
    while (char const* const name = listing->entries->next()) {
        if (listing->accepts(name) && (kind == ALL || listing->entries->isDirectory() == (kind == DIRECTORIES))) {
            return name;
        }
    }
    return nullptr;
}

void xos_DirClose(xos_Dir handle) {
    failsNow(Function::xos_DirClose, handle);
    delete listingOf(handle);
}

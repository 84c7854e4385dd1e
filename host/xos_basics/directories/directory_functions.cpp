// The functions of directories and of their listing.

#include "basis/ground/wildcard.h"
#include "basis/platform/xos_basics.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/directories/raw_listing.h"
#include "host/xos_basics/directories/tree.h"
#include "host/xos_basics/result.h"

#include <cstring>
#include <string>

using host::call;
using host::FAILED;
using host::Function;
using host::given;
using host::NEVER_FAILS;
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

xos_Dir openListing(char const* path, char const* pattern) {
    return host::unlessMemoryLacks(xos_Dir{0}, [&]() -> xos_Dir {
        auto listing = std::make_unique<Listing>();
        listing->entries = host::RawListing::open(path);
        if (listing->entries == nullptr) return 0;
        if (pattern != nullptr) listing->pattern = pattern;
        return reinterpret_cast<std::uintptr_t>(listing.release());
    });
}

char const* nextName(Listing& listing, int kind) {
    if (kind < ALL || kind > FILES) {
        host::setLastError(host::Error::BAD_ARGUMENT);
        return nullptr;
    }
    while (char const* const name = listing.entries->next()) {
        if (listing.accepts(name) && (kind == ALL || listing.entries->isDirectory() == (kind == DIRECTORIES))) {
            return name;
        }
    }
    return nullptr;
}

} // namespace

int xos_DirCreateEx(char const* path, int reserved) {
    auto const create = [=] { return resultOf([&] { return given(path) && host::createDirectory(path); }); };
    return call(Function::xos_DirCreateEx, FAILED, create, path, reserved);
}

int xos_DirRemove(char const* path, uint32_t flags) {
    auto const remove = [=] {
        return resultOf([&] { return given(path) && host::removeDirectory(path, (flags & RECURSIVE) != 0); });
    };
    return call(Function::xos_DirRemove, FAILED, remove, path, flags);
}

int xos_DirCopy(char const* dst, char const* src, uint32_t flags) {
    auto const copy = [=] {
        return resultOf([&] {
            return given(dst, src) && host::copyDirectory(dst, src, (flags & OVERWRITE) != 0, (flags & RECURSIVE) != 0);
        });
    };
    return call(Function::xos_DirCopy, FAILED, copy, dst, src, flags);
}

int xos_DirMove(char const* dst, char const* src, uint32_t flags) {
    auto const move = [=] {
        return resultOf([&] { return given(dst, src) && host::moveDirectory(dst, src, (flags & OVERWRITE) != 0); });
    };
    return call(Function::xos_DirMove, FAILED, move, dst, src, flags);
}

xos_Dir xos_DirOpenEx(char const* path, char const* pattern, uint32_t flags) {
    auto const open = [=] { return given(path) ? openListing(path, pattern) : xos_Dir{0}; };
    return call<xos_Dir>(Function::xos_DirOpenEx, 0, open, path, pattern, flags);
}

void xos_DirForceCaseAny(xos_Dir handle, int on) {
    auto const force = [=] {
        if (Listing* const listing = listingOf(handle)) listing->anyCase = on != 0;
        return NEVER_FAILS;
    };
    call(Function::xos_DirForceCaseAny, NEVER_FAILS, force, handle, on);
}

char const* xos_DirNextEx(xos_Dir handle, int kind, int reserved, uint32_t flags) {
    auto const next = [=]() -> char const* {
        Listing* const listing = listingOf(handle);
        return listing == nullptr ? nullptr : nextName(*listing, kind);
    };
    return call<char const*>(Function::xos_DirNextEx, nullptr, next, handle, kind, reserved, flags);
}

void xos_DirClose(xos_Dir handle) {
    auto const close = [=] {
        delete listingOf(handle);
        return NEVER_FAILS;
    };
    call(Function::xos_DirClose, NEVER_FAILS, close, handle);
}

/// \file
/// Listings as sets of names.

#ifndef TESTS_HOST_XOS_BASICS_DIRECTORIES_LISTING_H
#define TESTS_HOST_XOS_BASICS_DIRECTORIES_LISTING_H

#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"

enum Kind { ALL, DIRECTORIES, FILES };

/// {"(failed)"} where the listing cannot be opened.
inline Names listed(std::string const& path, char const* pattern = nullptr, int kind = ALL, bool anyCase = false) {
    xos_Dir const listing = xos_DirOpenEx(path.c_str(), pattern, 0);
    if (listing == 0) return {"(failed)"};
    if (anyCase) xos_DirForceCaseAny(listing, 1);
    Names names;
    while (char const* const name = xos_DirNextEx(listing, kind, 0, 0x4000)) {
        // Every name comes once.
        names.insert(names.count(name) == 0 ? name : std::string{name} + " (again)");
    }
    xos_DirClose(listing);
    return names;
}

#endif

/// \file
/// `Url`: fetches what a URL names.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_SYSTEM_URL_H
#define ZOR_BASIS_SYSTEM_URL_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

class ZB_API Url {
public:
    Url() = default;
    Url(Url const&) = default;
    Url(Url&&) noexcept = default;
    /// There is nothing to assign.
    Url& operator=(Url const&) { return *this; }
    Url& operator=(Url&&) noexcept { return *this; }

    /// Fetches into a file, through the platform layer, which decides which URLs it can fetch.
    /// \param target  the file's path; null is the empty one
    /// \param first  handed on to the platform layer with `second`; stand-alone they are user name and password, or null
    /// \param overwrite  may replace what is at the target
    /// \param makeDirectory  first makes the directory that is to hold the target, with its parents; stays also when fetching
    ///        fails. A bare name ("page.ps") has no directory in it that could be made, and fails: write "./page.ps"
    /// \return false, with nothing fetched, where that cannot be made, or something is there that may not be replaced; else
    ///         whether the platform layer has fetched it
    /// \error stand-alone an unknown host, a refused connection and the status of an answer have codes of their own
    /// \thread any
    static bool Get(char const* target, char const* url, char const* first, char const* second, bool overwrite,
                    bool makeDirectory);
};

} // namespace ZOR_Basis

#endif

/// \file
/// `Url`: fetches the resource that a URL names.
///
///     if (!Url::Get("spool/page.ps", "http://host/page.ps", nullptr, nullptr, true, true)) report();
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_SYSTEM_URL_H
#define ZOR_BASIS_SYSTEM_URL_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

class ZB_API Url {
public:
    Url() = default;
    Url(Url const&) = default;
    Url(Url&&) noexcept = default;
    /// Does nothing: the class has no state.
    Url& operator=(Url const&) { return *this; }
    Url& operator=(Url&&) noexcept { return *this; }

    /// Fetches a resource into a file through the platform layer, which decides which URLs it supports.
    /// \param target  is the file's path; null counts as the empty path
    /// \param first  is passed to the platform layer, as is `second`; the stand-alone layer takes them as user name and
    ///     password, or null
    /// \param overwrite  allows the target to be replaced
    /// \param makeDirectory  makes the directory of the target, with its parents, first; the directory stays even
    ///     if the fetch fails. A bare name ("page.ps") contains no directory to make, so the call fails: write
    ///     "./page.ps"
    /// \return false, with nothing fetched, if the directory cannot be made or the target exists and may not be
    ///     replaced; otherwise whether the platform layer fetched the resource
    /// \error the stand-alone layer has distinct codes for an unknown host, a refused connection and the status of a
    ///     response
    /// \thread any
    static bool Get(char const* target, char const* url, char const* first, char const* second, bool overwrite,
                    bool makeDirectory);
};

} // namespace ZOR_Basis

#endif

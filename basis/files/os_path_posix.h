/// \file
/// Paths as the system takes them; Windows takes both slash kinds and both kinds of text itself.

#ifndef BASIS_FILES_OS_PATH_POSIX_H
#define BASIS_FILES_OS_PATH_POSIX_H

#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/wb_str.h"

#include <cstring>

namespace ZOR_Basis {

/// Converts a name from the system to wide text. A byte that is not UTF-8 becomes U+DC80 to U+DCFF.
void wideName(char const* name, WBStr& out);
/// Converts a wide name to bytes and restores those of U+DC80 to U+DCFF; other unpaired surrogates become U+FFFD.
void narrowName(WChar const* name, BufStr<255>& out);

/// A path for one system call: every backslash is a slash.
class OsPath {
public:
    /// \param path  used itself, without a copy, where it has no backslash; null is the empty path
    explicit OsPath(char const* path) : text_(path != nullptr ? path : "") {
        if (std::strchr(text_, '\\') == nullptr) return;
        own_ = text_;
        becomeSlashes();
    }
    explicit OsPath(WChar const* path) {
        narrowName(path, own_);
        becomeSlashes();
    }
    OsPath(OsPath const&) = delete;
    OsPath& operator=(OsPath const&) = delete;

    operator char const*() const { return text_; }

private:
    void becomeSlashes() {
        for (char* at = own_.getBuf(); *at != '\0'; ++at) {
            if (*at == '\\') *at = '/';
        }
        text_ = own_.c_str();
    }

    BufStr<255> own_;
    char const* text_ = "";
};

} // namespace ZOR_Basis

#endif

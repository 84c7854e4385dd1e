/// \file
/// Paths as the system takes them; Windows takes both slash kinds and both kinds of text itself.

#ifndef BASIS_FILES_OS_PATH_POSIX_H
#define BASIS_FILES_OS_PATH_POSIX_H

#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/wb_str.h"

#include <cstring>

namespace ZOR_Basis {

/// The wide form of a name that the system gave. A byte that is no UTF-8 becomes U+DC80 to U+DCFF.
void wideName(char const* name, WBStr& out);
/// The bytes of a wide name, those of U+DC80 to U+DCFF restored; other unpaired surrogates become U+FFFD.
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

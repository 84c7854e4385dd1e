/// \file
/// Paths as Linux takes them, and the last error across a clean-up. For `_posix` sources only.

#ifndef HOST_XOS_BASICS_FILES_PATH_POSIX_H
#define HOST_XOS_BASICS_FILES_PATH_POSIX_H

#include "host/xos_basics/files/slashes.h"

#include <cerrno>
#include <string>

namespace host {

/// The path with slashes of the system's kind.
inline std::string systemPath(char const* path) {
    std::string text{path};
    unifySlashes(text, '/');
    return text;
}

/// The path of an entry itself: behind a slash at its end a link would be followed.
inline std::string entryPath(char const* path) {
    std::string text = systemPath(path);
    cutEndSlashes(text);
    return text;
}

/// Keeps the last error of a failure while what it left is cleared away.
class KeepErrno {
public:
    KeepErrno() : kept_(errno) {}
    ~KeepErrno() { errno = kept_; }
    KeepErrno(KeepErrno const&) = delete;
    KeepErrno& operator=(KeepErrno const&) = delete;

private:
    int kept_;
};

inline bool failWith(int error) {
    errno = error;
    return false;
}

} // namespace host

#endif

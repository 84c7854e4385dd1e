/// \file
/// Directory entries straight from the kernel, in large pieces. For `_posix` sources only.

#ifndef HOST_XOS_BASICS_DIRECTORIES_DIRENTS_POSIX_H
#define HOST_XOS_BASICS_DIRECTORIES_DIRENTS_POSIX_H

#include "host/xos_basics/files/slashes.h"

#include <array>
#include <cerrno>
#include <cstddef>
#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>

namespace host {

/// Reads the entries of one directory after the other through one buffer; each from the start, to its end.
class Dirents {
public:
    /// Goes on to the next entry but "." and "..".
    /// \return false at the end, and when reading failed
    bool next(int directory) {
        for (;;) {
            if (next_ == end_ && !fill(directory)) return false;
            entry_ = reinterpret_cast<dirent64 const*>(buffer_.data() + next_);
            next_ += entry_->d_reclen;
            if (!isDots(entry_->d_name)) return true;
        }
    }

    /// Whether the last reading failed, rather than having come to the end.
    bool failed() const { return failed_; }

    char const* name() const { return entry_->d_name; }

    /// The type bits of the entry's status, asked of the file system only where the directory does not tell.
    mode_t type(int directory) const {
        if (entry_->d_type != DT_UNKNOWN) return DTTOIF(entry_->d_type);
        struct stat status {};
        return ::fstatat(directory, entry_->d_name, &status, AT_SYMLINK_NOFOLLOW) == 0 ? status.st_mode & S_IFMT : 0;
    }

    /// The same without asking; 0: not told.
    mode_t toldType() const { return entry_->d_type == DT_UNKNOWN ? 0 : DTTOIF(entry_->d_type); }

private:
    bool fill(int directory) {
        ssize_t const got = ::getdents64(directory, buffer_.data(), buffer_.size());
        next_ = 0;
        end_ = got > 0 ? static_cast<std::size_t>(got) : 0;
        failed_ = got < 0;
        return got > 0;
    }

    alignas(dirent64) std::array<char, 32 * 1024> buffer_;
    std::size_t next_ = 0;
    std::size_t end_ = 0;
    bool failed_ = false;
    dirent64 const* entry_ = nullptr;
};

} // namespace host

#endif

/// \file
/// What Linux says of one entry.

#ifndef TESTS_HOST_SUPPORT_ENTRY_POSIX_H
#define TESTS_HOST_SUPPORT_ENTRY_POSIX_H

#include <filesystem>
#include <string>
#include <sys/stat.h>

/// Of a link, its own.
inline mode_t permissionsOf(std::string const& path) {
    struct stat status {};
    ::lstat(path.c_str(), &status);
    return status.st_mode & 07777;
}

inline std::string linkTarget(std::string const& path) { return std::filesystem::read_symlink(path).string(); }

#endif

// Used by named_mutex_posix.cpp; its counterpart for Windows names the system's own mutexes.

#include "host/xos_basics/semaphores/run_file_posix.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace host {
namespace {

/// A folder that others could write, or a link that others made, is not trusted.
bool isPrivateFolder(char const* path) {
    struct stat status {};
    if (lstat(path, &status) != 0) return false;
    if (S_ISDIR(status.st_mode) && status.st_uid == geteuid() && (status.st_mode & 077) == 0) return true;
    errno = EACCES;
    return false;
}

} // namespace

int openRunFile(std::span<char const* const> parents, std::string const& name) {
    std::string const folder = "/xos-" + std::to_string(geteuid());
    for (char const* parent : parents) {
        std::string path = parent + folder;
        bool const exists = mkdir(path.c_str(), 0700) == 0 || errno == EEXIST;
        if (!exists || !isPrivateFolder(path.c_str())) continue;
        path.append("/").append(name);
        int const file = open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0600);
        // A file system that cannot be written is so for all processes. What fails for one alone, for want of
        // descriptors perhaps, must not lead it to another place than the others.
        if (file >= 0 || errno != EROFS) return file;
    }
    return -1;
}

} // namespace host

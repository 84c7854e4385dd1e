// The sibling is url_files_win.cpp.

#include "host/xos_url/reason.h"
#include "host/xos_url/url_files.h"

#include <algorithm>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace host {

namespace {

bool isRegular(int file) {
    struct stat status {};
    if (fstat(file, &status) != 0) return false;
    if (S_ISDIR(status.st_mode)) return failFor(Reason::DIRECTORY);
    return S_ISREG(status.st_mode) || failFor(Reason::BAD_ARGUMENT);
}

/// Closes a file that cannot become a stream, because memory is short.
std::FILE* streamOf(int file, char const* mode) {
    std::FILE* const stream = fdopen(file, mode);
    if (stream != nullptr) return stream;
    KeepReason const keep;
    close(file);
    return nullptr;
}

} // namespace

std::string systemPath(std::string path) {
    std::replace(path.begin(), path.end(), '\\', '/');
    return path;
}

std::string pathOfFileUrl(FileUrl const& url) { return url.host.empty() ? url.path : std::string{}; }

std::FILE* createNewFile(std::string const& path) {
    int const file = open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    if (file < 0) return nullptr;
    std::FILE* const stream = streamOf(file, "wb");
    if (stream != nullptr) return stream;
    KeepReason const keep;
    removeFile(path);
    return nullptr;
}

std::FILE* openRegularFile(std::string const& path) {
    // Without waiting for a writer, should the name be a pipe's.
    int const file = open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (file < 0 || isRegular(file)) return file < 0 ? nullptr : streamOf(file, "rb");
    KeepReason const keep;
    close(file);
    return nullptr;
}

bool replaceFile(std::string const& from, std::string const& to) { return rename(from.c_str(), to.c_str()) == 0; }

void removeFile(std::string const& path) { unlink(path.c_str()); }

unsigned long processNumber() { return static_cast<unsigned long>(getpid()); }

} // namespace host

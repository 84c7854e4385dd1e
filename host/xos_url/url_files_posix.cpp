// The sibling is url_files_win.cpp.

#include "host/xos_url/reason.h"
#include "host/xos_url/url_files.h"

#include <algorithm>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace host {

namespace {

bool isRegular(int descriptor) {
    struct stat status {};
    if (fstat(descriptor, &status) != 0) return false;
    if (S_ISDIR(status.st_mode)) return failFor(Reason::DIRECTORY);
    return S_ISREG(status.st_mode) || failFor(Reason::BAD_ARGUMENT);
}

} // namespace

std::string systemPath(std::string path) {
    std::replace(path.begin(), path.end(), '\\', '/');
    return path;
}

std::string pathOfFileUrl(FileUrl const& url) { return url.host.empty() ? url.path : std::string{}; }

int newDescriptor(std::string const& path) { return open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666); }

int regularDescriptor(std::string const& path) {
    // Without waiting for a writer, should the name be a pipe's.
    int const descriptor = open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (descriptor < 0 || isRegular(descriptor)) return descriptor;
    KeepReason const keep;
    close(descriptor);
    return -1;
}

std::FILE* descriptorStream(int descriptor, char const* mode) { return fdopen(descriptor, mode); }

void closeDescriptor(int descriptor) { close(descriptor); }

bool replaceFile(std::string const& from, std::string const& to) { return rename(from.c_str(), to.c_str()) == 0; }

void removeFile(std::string const& path) { unlink(path.c_str()); }

unsigned long processNumber() { return static_cast<unsigned long>(getpid()); }

} // namespace host

// The sibling is url_files_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_url/url_files.h"

#include <algorithm>
#include <cctype>
#include <fcntl.h>
#include <io.h>
#include <sys/stat.h>

namespace host {

std::string systemPath(std::string path) {
    std::replace(path.begin(), path.end(), '/', '\\');
    return path;
}

std::string pathOfFileUrl(FileUrl const& url) {
    if (!url.host.empty()) return systemPath("//" + url.host + url.path);
    bool const hasDrive = url.path.size() >= 3 && std::isalpha(static_cast<unsigned char>(url.path[1])) != 0 &&
                          (url.path[2] == ':' || url.path[2] == '|');
    if (!hasDrive) return systemPath(url.path);
    std::string path = url.path.substr(1);
    path[1] = ':';
    return systemPath(path);
}

int newDescriptor(std::string const& path) {
    return _open(path.c_str(), _O_WRONLY | _O_CREAT | _O_EXCL | _O_BINARY | _O_NOINHERIT, _S_IREAD | _S_IWRITE);
}

int regularDescriptor(std::string const& path) {
    // A directory cannot be opened this way.
    return _open(path.c_str(), _O_RDONLY | _O_BINARY | _O_NOINHERIT);
}

std::FILE* descriptorStream(int descriptor, char const* mode) { return _fdopen(descriptor, mode); }

void closeDescriptor(int descriptor) { _close(descriptor); }

bool replaceFile(std::string const& from, std::string const& to) {
    return MoveFileExA(from.c_str(), to.c_str(), MOVEFILE_REPLACE_EXISTING) != 0;
}

void removeFile(std::string const& path) { DeleteFileA(path.c_str()); }

unsigned long processNumber() { return GetCurrentProcessId(); }

} // namespace host

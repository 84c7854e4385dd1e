// The sibling is url_files_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_url/reason.h"
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

namespace {

/// Closes a file that cannot become a stream, because memory is short.
std::FILE* streamOf(int file, char const* mode) {
    std::FILE* const stream = _fdopen(file, mode);
    if (stream != nullptr) return stream;
    KeepReason const keep;
    _close(file);
    return nullptr;
}

} // namespace

std::FILE* createNewFile(std::string const& path) {
    int const file =
        _open(path.c_str(), _O_WRONLY | _O_CREAT | _O_EXCL | _O_BINARY | _O_NOINHERIT, _S_IREAD | _S_IWRITE);
    if (file < 0) return nullptr;
    std::FILE* const stream = streamOf(file, "wb");
    if (stream != nullptr) return stream;
    KeepReason const keep;
    removeFile(path);
    return nullptr;
}

std::FILE* openRegularFile(std::string const& path) {
    // A directory cannot be opened this way.
    int const file = _open(path.c_str(), _O_RDONLY | _O_BINARY | _O_NOINHERIT);
    return file < 0 ? nullptr : streamOf(file, "rb");
}

bool replaceFile(std::string const& from, std::string const& to) {
    return MoveFileExA(from.c_str(), to.c_str(), MOVEFILE_REPLACE_EXISTING) != 0;
}

void removeFile(std::string const& path) { DeleteFileA(path.c_str()); }

unsigned long processNumber() { return GetCurrentProcessId(); }

} // namespace host

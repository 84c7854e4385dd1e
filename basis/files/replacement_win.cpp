// The sibling is replacement_posix.cpp.

#include "basis/files/replacement_impl.h"

#include "basis/files/opened_path_win.h"

#include <memory>
#include <new>

namespace ZOR_Basis {
namespace {

constexpr DWORD KEPT_ATTRIBUTES = FILE_ATTRIBUTE_HIDDEN | FILE_ATTRIBUTE_SYSTEM | FILE_ATTRIBUTE_NOT_CONTENT_INDEXED;

/// The access control list of a file, for a new file in the same folder.
class AccessList {
public:
    explicit AccessList(char const* path) {
        DWORD n = 0;
        GetFileSecurityA(path, DACL_SECURITY_INFORMATION, nullptr, 0, &n);
        if (n == 0) return;
        list_.reset(new (std::nothrow) char[n]);
        if (GetFileSecurityA(path, DACL_SECURITY_INFORMATION, list_.get(), n, &n) == FALSE) return;
        attributes_.lpSecurityDescriptor = list_.get();
    }
    SECURITY_ATTRIBUTES* get() { return attributes_.lpSecurityDescriptor != nullptr ? &attributes_ : nullptr; }

private:
    std::unique_ptr<char[]> list_;
    SECURITY_ATTRIBUTES attributes_{sizeof(SECURITY_ATTRIBUTES), nullptr, FALSE};
};

bool refuseWith(DWORD error) {
    SetLastError(error);
    return false;
}

/// Whether a file may be replaced as it may be written. \param attributes  receives those it has
bool mayReplace(char const* path, DWORD& attributes) {
    FileHandle const file(CreateFileA(path, GENERIC_WRITE, SHARE_ALL, nullptr, OPEN_EXISTING, 0, nullptr));
    if (!file.isOpen()) return false;
    if (GetFileType(file.get()) != FILE_TYPE_DISK) return refuseWith(ERROR_INVALID_PARAMETER);
    attributes = GetFileAttributesA(path);
    if (attributes == INVALID_FILE_ATTRIBUTES) return false;
    return (attributes & FILE_ATTRIBUTE_READONLY) == 0 || refuseWith(ERROR_ACCESS_DENIED);
}

Made make(char const* temporary, SECURITY_ATTRIBUTES* access, DWORD attributes) {
    FileHandle const made(CreateFileA(temporary, GENERIC_WRITE, SHARE_ALL, access, CREATE_NEW,
                                      attributes != 0 ? attributes : FILE_ATTRIBUTE_NORMAL, nullptr));
    if (made.isOpen()) return Made::YES;
    return GetLastError() == ERROR_FILE_EXISTS ? Made::NAME_TAKEN : Made::FAILED;
}

} // namespace

bool followLinks(char const* path, FPath& target) {
    if (path == nullptr || *path == '\0') return refuseWith(ERROR_PATH_NOT_FOUND);
    target = path;
    DWORD const attributes = GetFileAttributesA(path);
    bool const isLink = attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0;
    return !isLink || openedPath(path, target);
}

Made makeBeside(char const* temporary, char const* target) {
    DWORD attributes = 0;
    if (mayReplace(target, attributes)) return make(temporary, AccessList(target).get(), attributes & KEPT_ATTRIBUTES);
    return GetLastError() == ERROR_FILE_NOT_FOUND ? make(temporary, nullptr, 0) : Made::FAILED;
}

bool endsFolder(char c) { return c == '\\' || c == '/' || c == ':'; }

std::uint64_t processNumber() { return GetCurrentProcessId(); }

} // namespace ZOR_Basis

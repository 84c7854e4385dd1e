// Linux follows links by their text, in replacement_posix.cpp.

#include "basis/files/opened_path_win.h"

#include <memory>
#include <new>

namespace ZOR_Basis {
namespace {

constexpr DWORD FORM = FILE_NAME_NORMALIZED | VOLUME_NAME_DOS;

/// Removes the prefix that marks a path for the system alone.
void takePlain(char const* path, FPath& plain) {
    static constexpr char SHARE[] = "\\\\?\\UNC\\";
    static constexpr char MARK[] = "\\\\?\\";
    Str const text(path);
    if (text.beginWith(SHARE)) {
        plain = FPath("\\\\");
        static_cast<BufStr<255>&>(plain).add(path + sizeof SHARE - 1);
    } else {
        plain = text.beginWith(MARK) ? path + sizeof MARK - 1 : path;
    }
}

} // namespace

bool openedPath(char const* path, FPath& found) {
    FileHandle const file(CreateFileA(path, 0, SHARE_ALL, nullptr, OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr));
    if (!file.isOpen()) return false;
    DWORD const room = GetFinalPathNameByHandleA(file.get(), nullptr, 0, FORM) + 1;
    std::unique_ptr<char[]> const text(new (std::nothrow) char[room]);
    DWORD const n = GetFinalPathNameByHandleA(file.get(), text.get(), room, FORM);
    if (n == 0 || n >= room) return false;
    takePlain(text.get(), found);
    return true;
}

} // namespace ZOR_Basis

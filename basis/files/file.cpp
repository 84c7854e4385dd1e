#include "zor_basis/files/file.h"

#include "basis/files/file_backends.h"
#include "basis/files/last_error.h"
#include "basis/files/path_rules.h"
#include "basis/files/platform_flags.h"
#include "basis/files/whole_entry.h"
#include "zor_basis/files/dir.h"
#include "zor_basis/files/f_stat.h"

#include <new>

namespace ZOR_Basis {
namespace {

using PathRules::orEmpty;

IFile* makeBackend(char const* path, int mode, bool flag) {
    if ((mode & File::FILE_CRT) == 0) {
        return new (std::nothrow) FileXosBasics(path, flag ? mode | File::FILE_NOCREATEFLAG : mode);
    }
    if (flag) return new (std::nothrow) FileStdBuf(path, mode);
    return new (std::nothrow) FileStdDir(path, mode);
}

/// Opens a file, which makes it if nothing exists.
bool touch(char const* path) {
    xos_File const made = xos_FileOpen(orEmpty(path), OPEN_WRITES | OPEN_CREATES);
    if (made != 0) xos_FileCloseEx(made, 0);
    return made != 0;
}

bool isFileNow(char const* path) {
    FStat const entry(path);
    if (entry.exist() && !entry.isFile()) return refuse(Reason::ALREADY_THERE);
    return entry.isFile();
}

} // namespace

bool File::attach(IFile* file) {
    file_ = file;
    return isOpen();
}

bool File::open(char const* path, int mode, bool flag) {
    close();
    return attach(makeBackend(path, mode, flag));
}

// kept file-05: the handle is closed beforehand, by agreement.
bool File::openW(WChar const* path, int mode) { return attach(new (std::nothrow) FileStdBuf(path, mode)); }

void File::close() {
    delete file_;
    file_ = nullptr;
}

bool File::New(char const* path, bool makeDirs) {
    FStat const entry(path);
    if (entry.isDir()) return refuse(Reason::IS_DIRECTORY);
    if (entry.isFile()) return true;
    if (makeDirs && !Dir::NewFor(path)) return false;
    if (touch(path)) return isFileNow(path);
    KeepLastError const whyNotMade;
    return FStat::isFile(path);
}

bool File::Rem(char const* path, bool flagA, bool flagB) {
    return xos_FileRemove(orEmpty(path), flagIf(flagA, REMOVE_ALWAYS) | flagIf(flagB, SECOND_FLAG)) == 0;
}

bool File::Copy(char const* dst, char const* src, bool overwrite, bool makeDirs) {
    if (makeDirs && !Dir::NewFor(dst)) return false;
    return copyFile(dst, src, overwrite);
}

bool File::Move(char const* dst, char const* src, bool overwrite, bool makeDirs) {
    if (makeDirs && !Dir::NewFor(dst)) return false;
    if (xos_FileMove(orEmpty(dst), orEmpty(src), overwriteIf(overwrite)) == 0) return true;
    bool const hasPlace = !makeDirs || Dir::NewFor(dst);
    bool const copied = hasPlace && copyFile(dst, src, overwrite);
    // kept file-04: a caller that moves expects the source to be gone; it is better to send a job again than to find it
    // twice.
    KeepLastError const whyNotCopied;
    removeFile(src);
    return copied;
}

bool File::LinkOrCopy(char const* dst, char const* src, bool overwrite, bool makeDirs) {
    FStat const entry(dst);
    bool const isFree = entry.exist() ? freeDestination(dst, entry, overwrite) : !makeDirs || Dir::NewFor(dst);
    return isFree && linkOrCopy(dst, src);
}

} // namespace ZOR_Basis

/// \file
/// `File`: owns an open file, and offers operations on whole files.
///
/// The mode selects the backend: without `FILE_CRT` the platform layer's files, with it the runtime library's streams
/// (`flag` true) or descriptors (`flag` false). `openW` takes a wide path and always opens a stream.
///
/// | mode | platform layer: flags | stream: mode text | descriptor |
/// |---|---|---|---|
/// | `FILE_READ` | 0x02 | "r" | read only |
/// | `FILE_WRITE` | 0x14 | "w", with `FILE_READ` "r+" | create, read and write |
/// | `FILE_TRUNC` | 0x01 | with read and write "w+" | truncate |
/// | `FILE_APPEND` | 0x08 | alone "a+" | append |
/// | `FILE_BINARY` | always binary | "b" | binary |
/// | `FILE_SEQUENTIAL` | | "S", else "R" | sequential, else random |
/// | `FILE_NOCREATEFLAG`, or `flag` | leaves out 0x40; the file is created all the same | | |
/// | `FILE_PLATFORM_EXTRA` | 0x4000000 | | |
///
/// Operations on whole files take the destination first; the platform layer performs them. A null path counts as empty.
///
/// **`makeDirs` requires a slash.** A bare name ("page.ps") contains no folder to make, so `makeDirs` fails for it,
/// even if the file could be made in the current folder. Write "./page.ps" (dir-01).
///
///     File file("./spool/page.ps", File::FILE_WRITE | File::FILE_BINARY);
///     if (!file || file->write(bytes, size) != size) return false;
///     file.close();
///     return File::Move("./done/page.ps", "./spool/page.ps", true, true);
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread one thread at a time for each object; the static operations are thread-safe as far as the file system is

#ifndef ZOR_BASIS_FILES_FILE_H
#define ZOR_BASIS_FILES_FILE_H

#include "zor_basis/export.h"
#include "zor_basis/files/i_file.h"
#include "zor_basis/text/pointer_guard.h"
#include "zor_basis/wide_char.h"

#include <utility>

namespace ZOR_Basis {

class ZB_API File : public detail::NotDeletable<File> {
public:
    /// Open modes, which may be combined freely.
    enum Mode : int {
        FILE_READ = 0x001,
        FILE_WRITE = 0x002, ///< creates the file
        FILE_APPEND = 0x004,
        FILE_TRUNC = 0x008,
        FILE_BINARY = 0x010,
        FILE_SEQUENTIAL = 0x020,
        FILE_NOCREATEFLAG = 0x080,
        FILE_CRT = 0x100,
        FILE_PLATFORM_EXTRA = 0x200,
    };

    /// Constructs a file that is not open.
    File() = default;
    /// Construct the object and call `open` or `openW`.
    File(char const* path, int mode, bool flag = false) { open(path, mode, flag); }
    File(WChar const* path, int mode) { openW(path, mode); }
    File(File const&) = delete;
    File& operator=(File const&) = delete;
    /// Takes over the other's file, open or not; the other then holds nothing and may be opened again.
    File(File&& other) noexcept : file_(std::exchange(other.file_, nullptr)) {}
    /// Closes the file that this object holds and takes over the other's. Moving an object onto itself changes nothing.
    File& operator=(File&& other) noexcept {
        if (this == &other) return *this;
        close();
        file_ = std::exchange(other.file_, nullptr);
        return *this;
    }
    ~File() { close(); }

    /// Closes the file that is held and opens another. If that fails, the backend stays attached and its own `isOpen()`
    /// is false.
    /// \kept file-03: a stream opened for writing but not for reading always has mode "w", which truncates, whatever
    ///     else the mode says
    /// \error a stream whose mode has none of read, write and append is not opened
    /// \return whether the file is open
    bool open(char const* path, int mode, bool flag = false);
    /// Opens a stream by wide path.
    /// \kept file-05: unlike `open` this does not close the file that is held, which then belongs to whichever caller
    ///     has its pointer
    /// \pre nothing is held, or the caller has taken `ptr()` in order to delete it
    bool openW(WChar const* path, int mode);
    /// Closes the file that is held, if any.
    void close();

    /// Tells whether a file is held and open.
    bool isOpen() const { return file_ != nullptr && file_->isOpen(); }
    /// The same in a condition: `if (file)`, `if (!file)`, `file && other`. This applies to conditions only.
    /// Initialising a `bool` from a file (`bool held = file;`) and comparing a file with null use the conversion to a
    /// pointer, which is not null for a file that could not be opened.
    explicit operator bool() const { return isOpen(); }
    bool operator!() const { return !isOpen(); }
    /// The file that is held, owned by this object; null if there is none.
    IFile* ptr() const { return file_; }
    operator IFile*() const { return file_; }
    IFile* operator->() const { return file_; }

    /// Makes an empty regular file unless one exists; an existing file is not touched.
    /// \param makeDirs  calls `Dir::NewFor` first, which fails for a bare name: write "./name"
    /// \return false if the name is a directory's, or if the file cannot be made
    static bool New(char const* path, bool makeDirs);

    /// Removes a file.
    /// \param flagA, flagB  pass flags 0x400 and 0x800 to the platform layer
    static bool Rem(char const* path, bool flagA, bool flagB);

    /// Copies a file.
    /// \param makeDirs  calls `Dir::NewFor` for the destination first, which fails for a bare name: write "./name"
    static bool Copy(char const* dst, char const* src, bool overwrite, bool makeDirs);

    /// Moves a file; if the platform layer cannot move it, copies it and removes the source. A refused move onto an
    /// existing file is such a copy: it fails, and the source is gone. Check `FStat::exist(dst)` before, where it must
    /// survive.
    /// \param makeDirs  calls `Dir::NewFor` for the destination first; for a bare name that fails, and the source stays
    /// \kept file-04: the source is removed even if the copy fails, or if the directories cannot be made a second time
    /// \return whether the move or the copy succeeded
    static bool Move(char const* dst, char const* src, bool overwrite, bool makeDirs);

    /// Makes `dst` another name (a hard link) of `src`, or a copy if no link can be made. With `overwrite` an existing
    /// `dst` is removed first, a directory with all its contents.
    /// \param makeDirs  calls `Dir::NewFor` if nothing exists at `dst`; fails for a bare name: write "./name"
    /// \return false if `dst` exists and `overwrite` is false, and on any failure
    static bool LinkOrCopy(char const* dst, char const* src, bool overwrite, bool makeDirs);

private:
    bool attach(IFile* file);

    IFile* file_ = nullptr;
};

} // namespace ZOR_Basis

#endif

/// \file
/// `File`: the owner of an open file, and operations on whole files.
///
/// The mode chooses the backend: without `FILE_CRT` the platform layer's files, with it the runtime library's streams
/// (`flag` true) or descriptors (`flag` false). `openW` takes wide paths and always gives a stream.
///
/// | mode | platform layer: flags | stream: mode text | descriptor |
/// |---|---|---|---|
/// | `FILE_READ` | 0x02 | "r" | read only |
/// | `FILE_WRITE` | 0x14 | "w", with `FILE_READ` "r+" | create, read and write |
/// | `FILE_TRUNC` | 0x01 | with read and write "w+" | truncate |
/// | `FILE_APPEND` | 0x08 | alone "a+" | append |
/// | `FILE_BINARY` | always so | "b" | binary |
/// | `FILE_SEQUENTIAL` | | "S", else "R" | sequential, else random |
/// | `FILE_NOCREATEFLAG`, or `flag` | leaves out 0x40 | | |
/// | `FILE_PLATFORM_EXTRA` | 0x4000000 | | |
///
/// Operations on whole files take the destination first and are done by the platform layer. A null path is an empty one.
///
/// **`makeDirs` wants a slash.** A bare name ("page.ps") has no folder in it that could be made, so that `makeDirs` fails for
/// it, also where the file could be made in the current folder. Write "./page.ps" (dir-01).
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  one thread at a time for each object; the static operations are thread-safe as far as the file system is

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
    /// Open modes, combined freely.
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

    /// Nothing open.
    File() = default;
    /// `open` and `openW` at once.
    File(char const* path, int mode, bool flag = false) { open(path, mode, flag); }
    File(WChar const* path, int mode) { openW(path, mode); }
    File(File const&) = delete;
    File& operator=(File const&) = delete;
    /// Takes over what the other holds, open or not; the other then holds nothing and may be opened again.
    File(File&& other) noexcept : file_(std::exchange(other.file_, nullptr)) {}
    /// The same, after closing what is held. Moving an object onto itself changes nothing.
    File& operator=(File&& other) noexcept {
        if (this == &other) return *this;
        close();
        file_ = std::exchange(other.file_, nullptr);
        return *this;
    }
    ~File() { close(); }

    /// Opens a file, after closing the one that is held. The backend stays attached where that fails; its own `isOpen()`
    /// is then false.
    /// \kept file-03: a stream for writing without reading is always "w", which truncates, whatever else the mode says
    /// \error a stream without any of read, write and append is not opened
    /// \return whether the file is open
    bool open(char const* path, int mode, bool flag = false);
    /// Opens a stream by a wide path.
    /// \kept file-05: unlike `open` this does not close what is held, which then belongs to whoever has its pointer
    /// \pre nothing is held, or the caller has taken its `ptr()` to delete it
    bool openW(WChar const* path, int mode);
    /// Closes what is held, if anything.
    void close();

    /// Whether something is held and open.
    bool isOpen() const { return file_ != nullptr && file_->isOpen(); }
    /// The same in a condition: `if (file)`, `if (!file)`, `file && other`. Only a condition asks this. Initialising a
    /// `bool` from a file (`bool held = file;`) and comparing one with null go by way of the pointer, and that is not null
    /// for a file that could not be opened.
    explicit operator bool() const { return isOpen(); }
    bool operator!() const { return !isOpen(); }
    /// What is held, owned by this object; null if nothing is.
    IFile* ptr() const { return file_; }
    operator IFile*() const { return file_; }
    IFile* operator->() const { return file_; }

    /// Makes sure that there is a regular file; one that is there is not touched.
    /// \param makeDirs  first `Dir::NewFor`, which fails for a bare name: write "./name"
    /// \return false where a directory of that name is there, and where the file cannot be made
    static bool New(char const* path, bool makeDirs);

    /// Removes a file. \param flagA, flagB  hand flags 0x400 and 0x800 to the platform layer
    static bool Rem(char const* path, bool flagA, bool flagB);

    /// Copies a file.
    /// \param makeDirs  first `Dir::NewFor` of the destination, which fails for a bare name: write "./name"
    static bool Copy(char const* dst, char const* src, bool overwrite, bool makeDirs);

    /// Moves a file; where the platform layer cannot move, copies it and removes the source.
    /// \param makeDirs  first `Dir::NewFor` of the destination, which fails for a bare name, and the source stays
    /// \kept file-04: the source is removed even when the copy has failed, or its directories could not be made again
    /// \return whether the move or the copy succeeded
    static bool Move(char const* dst, char const* src, bool overwrite, bool makeDirs);

    /// Makes `dst` another name of `src`, or a copy where that cannot be. What is there already is removed first, with
    /// `overwrite`: a directory with all that is in it.
    /// \param makeDirs  `Dir::NewFor`, where nothing is there yet; fails for a bare name: write "./name"
    /// \return false where something is there without `overwrite`, and on any failure
    static bool LinkOrCopy(char const* dst, char const* src, bool overwrite, bool makeDirs);

private:
    bool attach(IFile* file);

    IFile* file_ = nullptr;
};

} // namespace ZOR_Basis

#endif

/// \file
/// `Dir`: operations on whole directories.
///
/// The platform layer does the work; this class decides the order of its calls, the flags that it gets, and what counts
/// as success. Destinations come first. Paths may contain both kinds of slash. A null path counts as empty; nothing
/// exists at an empty path, and nothing can be made there.
///
///     if (!Dir::New("jobs/7/pages", true)) return false; // with its parents; true also if it exists
///     return Dir::Rem("jobs/7", true, false);            // with all its contents
///
/// On Linux a symbolic link is neither a file nor a directory, unless a function says otherwise.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread thread-safe as far as the file system is

#ifndef ZOR_BASIS_FILES_DIR_H
#define ZOR_BASIS_FILES_DIR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/wide_char.h"

namespace ZOR_Basis {

class ZB_API Dir {
public:
    /// Tells whether an entry of any kind exists.
    static bool Exist(char const* path);

    /// Makes a directory. An existing one counts as success; on Linux so does a link to one.
    /// \param makeParents  calls `NewFor` first
    /// \kept dir-01: a path without a slash has no parent to make, so `makeParents` fails for it; "./name" has one
    /// \return false if a file is in the way, a parent cannot be made, or the platform layer fails
    static bool New(char const* path, bool makeParents);

    /// Makes the directory that contains `path`, with all its parents, unless it exists.
    /// \kept dir-02: if the only slash is the first character, the whole path counts as the parent: "/abc" itself is
    ///     made
    /// \return false if the path has no slash, a file is in the way, or the platform layer fails
    /// \cost looks for an existing directory from the deepest one upwards, then makes the missing ones downwards
    static bool NewFor(char const* path);

    /// The same for wide paths, through the system instead of the platform layer; any existing entry that is not a
    /// directory is in the way. On Windows a parent that is followed by two slashes is not found.
    static bool NewW(WChar const* path, bool makeParents);
    static bool NewForW(WChar const* path);

    /// Removes a directory; with `recursive` also all its contents. Links in it are removed, never followed.
    /// \param flagB  passes flag 0x800 to the platform layer
    /// \return true also if nothing exists there; false for a regular file (`File::Rem` removes those)
    static bool Rem(char const* path, bool recursive, bool flagB);

    /// Copies a directory.
    /// \param recursive  copies all sub-directories, too (flag 0x200)
    /// \param overwrite  allows files of the destination to be replaced (flag 0x001)
    /// \param flagB  passes flag 0x800
    static bool Copy(char const* dst, char const* src, bool recursive, bool overwrite, bool flagB);

    /// Moves a directory; if the platform layer cannot move it, copies it and removes the source.
    /// \kept dir-03: the source is removed even if the copy fails
    /// \return whether the move or the copy succeeded
    static bool Move(char const* dst, char const* src, bool overwrite, bool flagB);

    /// Makes `dst` another name (a hard link) of the file `src`.
    static bool Link(char const* dst, char const* src);

    /// Finds the deepest existing entry above the last component of a path. It looks at the whole path without its
    /// trailing slashes, while that exists, and then at what stands before each earlier slash.
    /// \param existing  receives that entry, without a trailing slash
    /// \param rest  receives what follows it in the path, which may also exist; trailing slashes belong to it only if
    ///     it does not exist
    /// \kept dir-04: a slash at index 0 or 1 is never examined, so the result is false for a path of fewer than three
    ///     characters, and for one that exists no deeper than such a slash
    /// \pre neither output is the path itself
    /// \return false if there is none: `rest` is then empty, and `existing` is what was examined last, or the whole
    ///     path; for a path that is too short it is empty, too
    static bool SplitCheck(char const* path, FPath& existing, FPath& rest);
};

} // namespace ZOR_Basis

#endif

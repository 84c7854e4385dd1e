/// \file
/// `Dir`: operations on whole directories.
///
/// The work is done by the platform layer; here is the order of its calls, the flags that are handed to it, and what
/// counts as success. Destinations come first. Paths may have both slash kinds; a null path is an empty one, where nothing
/// is and nothing can be made.
///
/// On Linux a symbolic link is neither a file nor a directory, except where a function says otherwise.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  thread-safe as far as the file system is

#ifndef ZOR_BASIS_FILES_DIR_H
#define ZOR_BASIS_FILES_DIR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/wide_char.h"

namespace ZOR_Basis {

class ZB_API Dir {
public:
    /// Whether there is an entry of any kind.
    static bool Exist(char const* path);

    /// Makes a directory. One that is there already is as good, on Linux also a link to one.
    /// \param makeParents  first `NewFor`
    /// \kept dir-01: a path without a slash has no parent that could be made, so `makeParents` fails there; "./name" has one
    /// \return false where a file is in the way, a parent cannot be made, or the platform layer fails
    static bool New(char const* path, bool makeParents);

    /// Makes sure of the directory that is to hold `path`, with all its parents.
    /// \kept dir-02: where the only slash is the first character, the parent is the whole path: "/abc" is made itself
    /// \return false without a slash in the path, and where a file is in the way or the platform layer fails
    /// \cost tries from the deepest directory upwards and then makes them downwards
    static bool NewFor(char const* path);

    /// The same by wide paths, through the system instead of the platform layer; whatever exists and is no directory is in
    /// the way. Under Windows parents that are followed by two slashes are not found.
    static bool NewW(WChar const* path, bool makeParents);
    static bool NewForW(WChar const* path);

    /// Removes a directory, with `recursive` together with all that is in it; links in it are removed, never followed.
    /// \param flagB  hands flag 0x800 to the platform layer
    /// \return true also where nothing is there; false for a regular file (`File::Rem` removes those)
    static bool Rem(char const* path, bool recursive, bool flagB);

    /// Copies a directory.
    /// \param recursive  flag 0x200: with all its sub-directories
    /// \param overwrite  flag 0x001: files of the destination may be replaced
    /// \param flagB  flag 0x800
    static bool Copy(char const* dst, char const* src, bool recursive, bool overwrite, bool flagB);

    /// Moves a directory; where the platform layer cannot move, copies it and removes the source.
    /// \kept dir-03: the source is removed even when the copy has failed
    /// \return whether the move or the copy succeeded
    static bool Move(char const* dst, char const* src, bool overwrite, bool flagB);

    /// Makes `dst` another name of the file `src`.
    static bool Link(char const* dst, char const* src);

    /// Finds the deepest existing entry above the last component of a path: looks at the whole path without its slashes at
    /// the end, while that exists, and then at what stands before each earlier slash.
    /// \param existing  receives that entry, without a slash at its end
    /// \param rest  receives what follows it in the path; existing components that end in a slash are taken for such
    /// \kept dir-04: a slash at index 0 or 1 is never looked at, so paths of fewer than three characters, and all that exist
    ///     no deeper than there, give false
    /// \pre the outputs are not the path
    /// \return false if there is none: `rest` is empty then, and `existing` what was looked at last, or the whole path; of
    ///         paths that are too short it is empty, too
    static bool SplitCheck(char const* path, FPath& existing, FPath& rest);
};

} // namespace ZOR_Basis

#endif

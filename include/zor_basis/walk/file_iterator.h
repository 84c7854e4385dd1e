/// \file
/// `FileIterator`: walks a directory or a whole tree, or lists the names in one directory.
///
///     FileCountVisitor counter(0);
///     FileIterator(folder, LOOK_FILES, "*.txt", nullptr).doIt(&counter, true, false);
///
/// **Order of a walk.** A walk reports all entries of a directory first and then walks each sub-directory, both in the
/// order of the platform layer's listing, unsorted. So a directory is reported before its contents. The depth is not
/// limited; one listing is open for each level.
///
/// **Kinds.** The low two bits of the type select what is reported:
///
/// | type | walk | flat listing |
/// |---|---|---|
/// | `LOOK_ALL` | directories | everything |
/// | `LOOK_FILES` | files | files |
/// | `LOOK_DIRS` | directories | directories |
/// | `LOOK_BOTH` | everything | everything |
///
/// With `LOOK_ANYCASE` added to the type the wildcard ignores the case of letters.
///
/// **Links.** On Linux a link is listed as a file, whatever its target, so a walk never follows one; only the directory
/// at which it starts may be a link.
///
/// \kept walk-01: walk and flat listing differ for `LOOK_ALL`, as in the table above
/// \kept walk-02: a walk reports an entry as a file only if its status is that of a regular file. It reports everything
///     else as a directory: links, devices, and entries that have gone meanwhile. Only files have a size
/// \kept walk-03: walks neither report nor enter an entry of the exact name "__MACOS"; the flat listing returns it
/// \kept walk-04: walks enter all sub-directories, whatever the wildcard and the condition say of them
/// \kept walk-05: the result of a walk is that of the last `perform`, so without `stopOnFalse` a later success hides a
///     failure. The result of a deep walk is that of its last sub-directory, or true without one: it is true unless
///     `stopOnFalse` or `stop` ends the walk
/// \kept walk-06: a directory that cannot be opened counts as empty: a walk of it returns true and never calls the
///     visitor
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread one thread at a time

#ifndef ZOR_BASIS_WALK_FILE_ITERATOR_H
#define ZOR_BASIS_WALK_FILE_ITERATOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/files/look_for_type.h"
#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/str.h"
#include "zor_basis/walk/file_condition.h"
#include "zor_basis/walk/file_visitor.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API FileIterator {
public:
    /// \param path  names the directory
    /// \param wildcard  matches as in `FPath::matchWildCard`; null or empty matches all names
    /// \param condition  is asked about each entry that matches otherwise; may be null; not owned, must outlive the
    ///     iterator's use
    FileIterator(char const* path, LookForType type, char const* wildcard, FileCondition* condition);
    FileIterator(Str const& path, LookForType type, char const* wildcard, FileCondition* condition);
    /// Constructs an iterator with an empty path, an empty wildcard and no condition.
    FileIterator(LookForType type);
    /// Copies the settings; the copy has no open listing.
    FileIterator(FileIterator const& other);
    /// Closes an open listing and copies the settings.
    FileIterator& operator=(FileIterator const& other);
    /// Closes an open listing.
    ~FileIterator();

    /// \name Settings
    /// A change does not affect path, wildcard and encryption of an open listing.
    /// @{
    void setPath(char const* path) { path_ = path; }
    void setPath(Str const& path) { path_ = path; }
    void setType(LookForType type) { type_ = type; }
    void setWildCard(char const* wildcard) { wildcard_ = wildcard; }
    void setCondition(FileCondition* condition) { condition_ = condition; }
    /// Sets whether the tree lies in the platform's encrypted store: directories are then opened with flag 0x4000000,
    /// and the status of entries comes from the system alone.
    void setCrypted(bool crypted) { crypted_ = crypted; }
    /// @}

    /// \name Walking
    /// Each closes a flat listing of this iterator first.
    /// @{
    /// Reports the directory's entries; with `deep` it then walks the sub-directories.
    /// \param visitor  handles each entry; not null
    /// \param stopOnFalse  ends the whole walk, with result false, when the visitor returns false
    /// \return true, or the visitor's last result, as walk-05 says
    bool doIt(FileVisitor* visitor, bool deep, bool stopOnFalse);
    /// The same walk, by a temporary iterator.
    static bool doIt(Str const& path, LookForType type, FileVisitor* visitor, char const* wildcard,
                     FileCondition* condition, bool deep, bool stopOnFalse, bool crypted);

    /// Reports the directory's entries only.
    bool shallowIteration(FileVisitor* visitor, bool stopOnFalse);
    /// Walks the sub-directories only, each with all its contents.
    bool deepIteration(FileVisitor* visitor, bool stopOnFalse);
    /// The same two for the rest of the listing that `start` has opened, which stays open. True if no listing is open.
    bool shallowRide(FileVisitor* visitor, bool stopOnFalse);
    bool deepRide(FileVisitor* visitor, bool stopOnFalse);
    /// @}

    /// \name Flat listing
    ///
    ///     FileIterator list(folder, LOOK_FILES, "*.txt", nullptr);
    ///     while (char const* name = list.next()) use(name);
    /// @{
    /// Closes an open listing and opens a new one.
    /// \param useWildcard  applies the wildcard; false: the listing has all names, in any case
    /// \return false if the directory cannot be opened
    bool start(bool useWildcard);
    /// Returns the next name. If no listing is open, it calls `start(true)` first.
    /// \return the name, valid until the next call; null if the directory cannot be opened, and at the end, where the
    ///     listing is closed so that a further call begins again
    char const* next();
    /// Closes an open listing.
    void finish();
    /// @}

private:
    bool open(bool useWildcard, bool anyCase);
    char const* nextName(int kind);

    FPath path_;
    LookForType type_;
    BufStr<255> wildcard_;
    FileCondition* condition_ = nullptr;
    std::uint64_t handle_ = 0;
    bool crypted_ = false;
};

} // namespace ZOR_Basis

#endif

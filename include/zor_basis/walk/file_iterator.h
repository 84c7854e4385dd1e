/// \file
/// `FileIterator`: walks a directory or a whole tree, or lists the names of one directory.
///
///     FileCountVisitor counter(0);
///     FileIterator(folder, LOOK_FILES, "*.txt", nullptr).doIt(&counter, true, false);
///
/// **Order of a walk.** In every directory first all of its own entries, then each sub-directory as a whole, both in the
/// order of the platform layer's listing, unsorted. So a directory is reported before what is in it. There is no limit to
/// the depth; one listing is open for each level.
///
/// **Kinds.** What the low two bits of the type report:
///
/// | type | walk | flat listing |
/// |---|---|---|
/// | `LOOK_ALL` | directories | everything |
/// | `LOOK_FILES` | files | files |
/// | `LOOK_DIRS` | directories | directories |
/// | `LOOK_BOTH` | everything | everything |
///
/// `LOOK_ANYCASE` added to the type makes the wildcard match whatever the case of the letters.
///
/// **Links.** On Linux a link is listed as a file, whatever it leads to, so that a walk never follows one; only the
/// directory that it starts at may be a link.
///
/// \kept walk-01: the two uses differ for `LOOK_ALL`, as tabled above
/// \kept walk-02: an entry of a walk is a file where its status says regular file; all else is reported as a directory:
///     links, devices, and what has gone meanwhile. Only files have a size
/// \kept walk-03: walks neither report nor enter an entry of the exact name "__MACOS"; the flat listing gives it
/// \kept walk-04: sub-directories are entered whatever the wildcard and the condition say of them
/// \kept walk-05: the result is that of the last `perform`, so that without `stopOnFalse` a later success hides a failure; a
///     deep walk's is that of its last sub-directory, true without one: it is true unless `stopOnFalse` or `stop` ends it
/// \kept walk-06: a directory that cannot be opened is empty: a walk of it is true, and calls the visitor never
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  one thread at a time

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
    /// \param path  the directory
    /// \param wildcard  by the rule of `FPath::matchWildCard`; null or empty means all names
    /// \param condition  asked of each entry that fits otherwise; may be null; not owned, outlives the iterator's use
    FileIterator(char const* path, LookForType type, char const* wildcard, FileCondition* condition);
    FileIterator(Str const& path, LookForType type, char const* wildcard, FileCondition* condition);
    /// Path and wildcard are empty, there is no condition.
    FileIterator(LookForType type);
    /// Copies the settings; the copy has no open listing.
    FileIterator(FileIterator const& other);
    /// The same after closing an open listing.
    FileIterator& operator=(FileIterator const& other);
    /// Closes an open listing.
    ~FileIterator();

    /// \name Settings
    /// A listing that is open goes on with its own path, wildcard and encryption.
    /// @{
    void setPath(char const* path) { path_ = path; }
    void setPath(Str const& path) { path_ = path; }
    void setType(LookForType type) { type_ = type; }
    void setWildCard(char const* wildcard) { wildcard_ = wildcard; }
    void setCondition(FileCondition* condition) { condition_ = condition; }
    /// Whether the tree lives on the platform's encrypted store: directories are opened with flag 0x4000000, and the
    /// status of entries is asked of the system alone.
    void setCrypted(bool crypted) { crypted_ = crypted; }
    /// @}

    /// \name Walking
    /// Each closes a flat listing of this iterator.
    /// @{
    /// Reports the directory's entries, and with `deep` then walks its sub-directories.
    /// \param visitor  not null
    /// \param stopOnFalse  a false of the visitor ends the whole walk, which is then false
    /// \return true, or the last result of the visitor as walk-05 has it
    bool doIt(FileVisitor* visitor, bool deep, bool stopOnFalse);
    /// The same walk by an iterator of its own.
    static bool doIt(Str const& path, LookForType type, FileVisitor* visitor, char const* wildcard,
                     FileCondition* condition, bool deep, bool stopOnFalse, bool crypted);

    /// The directory's own entries only.
    bool shallowIteration(FileVisitor* visitor, bool stopOnFalse);
    /// The sub-directories only, each with all that is in it.
    bool deepIteration(FileVisitor* visitor, bool stopOnFalse);
    /// The same two over what is left of the listing that `start` has opened, which stays open. True without one.
    bool shallowRide(FileVisitor* visitor, bool stopOnFalse);
    bool deepRide(FileVisitor* visitor, bool stopOnFalse);
    /// @}

    /// \name Flat listing
    ///
    ///     while (char const* name = list.next()) use(name);
    /// @{
    /// Opens a listing, after closing one that is open. \param useWildcard  false: of all names, in any case
    /// \return false where the directory cannot be opened
    bool start(bool useWildcard);
    /// The next name; where no listing is open, first `start(true)`.
    /// \return valid until the next call; null at the end, when the listing is closed, so that the call after it begins
    ///         again, and where the directory cannot be opened
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

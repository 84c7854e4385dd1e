/// \file
/// `FindFileVisit`: searches by name or extension during a walk. `zbFindFile`: searches by wildcard.
///
///     FPath ticket;
///     if (zbFindFile(folder, "*.jdf", LOOK_FILES, ticket, true, true) != 0) open(ticket);

#ifndef ZOR_BASIS_WALK_FIND_FILE_VISIT_H
#define ZOR_BASIS_WALK_FIND_FILE_VISIT_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/files/look_for_type.h"
#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/str.h"
#include "zor_basis/walk/file_visitor.h"

#include <cstdint>

namespace ZOR_Basis {

/// The comparison ignores case. Without a name or an extension every entry matches.
/// \thread the walking thread
class ZB_API FindFileVisit : public FileVisitor {
public:
    /// \param keepLast  remembers the last match; false: the first
    /// \param maxCount  ends the walk after so many matches; 0 or less: never
    FindFileVisit(bool keepLast, int maxCount) : keepLast_(keepLast), maxCount_(maxCount) {}

    /// From now on entries with exactly this name match; with an empty name all do.
    void searchName(Str const& name);
    /// From now on entries with this extension match.
    /// \kept walk-09: the function puts a "." before the extension even if there is one: ".txt" searches for "..txt"
    void searchExt(char const* ext) { searchExt(Str(ext)); }
    void searchExt(Str const& ext);
    /// Forgets the matches and the search key.
    void clear();
    /// The number of matches so far.
    int getNum() const { return count_; }
    /// The full path of the remembered match; empty if there is none.
    FPath const& getPath() const { return path_; }

    /// Examines one entry.
    /// \return true: a search never fails a walk
    bool perform(FileEntry* entry) override;
    bool stop() override;

private:
    bool matches(FileEntry const& entry) const;

    bool keepLast_;
    bool byName_ = false;
    FPath path_;
    std::int32_t count_ = 0;
    std::int32_t maxCount_;
    BufStr<255> key_;
};

} // namespace ZOR_Basis

/// Searches a directory, with `deep` its whole tree, for the entries that a walk reports for the type and the wildcard.
/// The wildcard ignores case only with `LOOK_ANYCASE`.
/// \param found  receives the full path of a match; empty if there is none
/// \param firstOnly  ends the search at the first match; false: counts all matches and returns the last. Both in the
///     order of the walk.
/// \return the number of matches; 0 if the directory is missing
/// \thread thread-safe as far as the file system is
ZB_API int zbFindFile(ZOR_Basis::Str const& dir, char const* wildcard, ZOR_Basis::LookForType type,
                      ZOR_Basis::FPath& found, bool firstOnly, bool deep);

#endif

/// \file
/// `FindFileVisit`: searches by name or extension during a walk. And `zbFindFile`, which searches by wildcard.

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

/// Letters match in either case. Without a name or extension every entry is a match.
/// \thread  the walking thread
class ZB_API FindFileVisit : public FileVisitor {
public:
    /// \param keepLast  remembers the last match, else the first
    /// \param maxCount  ends the walk after so many matches; 0 or below: never
    FindFileVisit(bool keepLast, int maxCount) : keepLast_(keepLast), maxCount_(maxCount) {}

    /// From now on entries of this whole name match; with an empty one all do.
    void searchName(Str const& name);
    /// From now on entries of this extension match.
    /// \kept walk-09: a "." is put before the extension even where it has one: ".txt" looks for "..txt"
    void searchExt(char const* ext) { searchExt(Str(ext)); }
    void searchExt(Str const& ext);
    /// Forgets the matches and what was searched for.
    void clear();
    /// The matches so far.
    int getNum() const { return count_; }
    /// The remembered match, directory and name; empty if there is none.
    FPath const& getPath() const { return path_; }

    /// Looks at one entry. \return true: a search fails no walk
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

/// Searches a directory, with `deep` its whole tree, for what a walk reports for the type and the wildcard, whose letters
/// match in either case with `LOOK_ANYCASE` only.
/// \param found  receives the path of a match, directory and name; empty where there is none
/// \param firstOnly  ends at the first match; else all are counted and the last one is given. Both in the order of the walk.
/// \return the number of matches; 0 for a directory that is missing
/// \thread  thread-safe as far as the file system is
ZB_API int zbFindFile(ZOR_Basis::Str const& dir, char const* wildcard, ZOR_Basis::LookForType type,
                      ZOR_Basis::FPath& found, bool firstOnly, bool deep);

#endif

/// \file
/// `FileCountVisitor`: counts the entries that a walk reports.

#ifndef ZOR_BASIS_WALK_FILE_COUNT_VISITOR_H
#define ZOR_BASIS_WALK_FILE_COUNT_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/look_for_type.h"
#include "zor_basis/text/str.h"
#include "zor_basis/walk/file_visitor.h"

#include <cstdint>

namespace ZOR_Basis {

/// \thread the walking thread
class ZB_API FileCountVisitor : public FileVisitor {
public:
    /// \param limit  ends the walk when so many entries are counted; 0: never
    /// \kept walk-08: only the low 32 bits of the limit are compared, as a signed number, so a limit of 2^31 or 2^32
    ///     ends the walk before its first entry
    FileCountVisitor(std::uint64_t limit) : limit_(limit) {}

    /// Counts the entry.
    /// \return true
    bool perform(FileEntry* entry) override;
    bool stop() override;
    int total() const { return count_; }

    /// Counts the direct entries of one directory, of the kinds that a walk reports for the type.
    /// \return the number of entries, at most the limit; 0 also if the directory cannot be listed
    static int Get(Str const& path, LookForType type, std::uint64_t limit);

private:
    std::uint64_t limit_;
    std::int32_t count_ = 0;
};

} // namespace ZOR_Basis

#endif

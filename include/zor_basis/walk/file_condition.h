/// \file
/// `FileCondition`: decides which of the entries that match kind and wildcard are kept.
///
///     struct NotHidden : FileCondition {
///         bool acceptEntry(FileEntry* entry) override { return entry->getName().first() != '.'; }
///     };
///
/// \thread called by the listing or walking thread

#ifndef ZOR_BASIS_WALK_FILE_CONDITION_H
#define ZOR_BASIS_WALK_FILE_CONDITION_H

#include "zor_basis/export.h"
#include "zor_basis/files/file_entry.h"

namespace ZOR_Basis {

class FileIterator;

/// Keeps everything; derived classes decide.
class ZB_API FileCondition {
public:
    FileCondition() = default;
    FileCondition(FileCondition const&) = default;
    FileCondition(FileCondition&&) = default;
    FileCondition& operator=(FileCondition const&) = default;
    FileCondition& operator=(FileCondition&&) = default;

    /// Called by the flat listing (`FileIterator::next`).
    /// \return whether to keep the name
    virtual bool acceptName(FileIterator* it, char const* name);
    /// Called by walks.
    /// \return whether to report the entry; a walk enters a directory even if it is not reported
    virtual bool acceptEntry(FileEntry* entry);
    virtual ~FileCondition();
};

} // namespace ZOR_Basis

#endif

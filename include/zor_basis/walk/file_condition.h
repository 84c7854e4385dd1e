/// \file
/// `FileCondition`: which of the entries that fit kind and wildcard are kept.
///
/// \thread  called by the listing or walking thread

#ifndef ZOR_BASIS_WALK_FILE_CONDITION_H
#define ZOR_BASIS_WALK_FILE_CONDITION_H

#include "zor_basis/export.h"
#include "zor_basis/files/file_entry.h"

namespace ZOR_Basis {

class FileIterator;

/// Keeps everything; derived classes choose.
class ZB_API FileCondition {
public:
    FileCondition() = default;
    FileCondition(FileCondition const&) = default;
    FileCondition(FileCondition&&) = default;
    FileCondition& operator=(FileCondition const&) = default;
    FileCondition& operator=(FileCondition&&) = default;

    /// Asked by the flat listing (`FileIterator::next`). \return whether to keep the name
    virtual bool acceptName(FileIterator* it, char const* name);
    /// Asked by walks. \return whether to report the entry; a directory that is not reported is entered all the same
    virtual bool acceptEntry(FileEntry* entry);
    virtual ~FileCondition();
};

} // namespace ZOR_Basis

#endif

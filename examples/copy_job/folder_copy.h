/// \file
/// Copies a folder with all that is in it, and shows how it goes on.

#ifndef EXAMPLES_COPY_JOB_FOLDER_COPY_H
#define EXAMPLES_COPY_JOB_FOLDER_COPY_H

#include "examples/copy_job/progress_line.h"

#include <zor_basis/files.h>

/// One shallow walk a folder, with `FileCopyVisitor`, so that the progress moves with every file.
class FolderCopy {
public:
    /// \param target  is made; what is there already is replaced, file by file
    /// \return false at the first entry that cannot be copied; what has been copied stays
    bool run(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& target);
    /// The entry that could not be copied.
    ZOR_Basis::FPath const& failedAt() const { return failedAt_; }

private:
    bool copyFiles(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& target);
    bool copyFolders(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& target);
    bool copyFolder(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& target);

    ProgressLine progress_;
    ZOR_Basis::FPath failedAt_;
};

#endif

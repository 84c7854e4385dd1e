/// \file
/// Compares a folder with its copy.

#ifndef EXAMPLES_COPY_JOB_FOLDER_VERIFICATION_H
#define EXAMPLES_COPY_JOB_FOLDER_VERIFICATION_H

#include <zor_basis/files.h>

/// Every regular file of the source has to be in the copy with the same bytes. Links are not followed.
class FolderVerification {
public:
    FolderVerification(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& copy) : source_(source), copy_(copy) {}
    /// \return false at the first file that differs or is missing
    bool run() { return verify(source_, copy_); }
    int files() const { return files_; }
    /// The file that differs or is missing, by its place in the source.
    ZOR_Basis::FPath const& failedAt() const { return failedAt_; }

private:
    bool verify(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& copy);
    bool verifyFiles(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& copy);

    ZOR_Basis::FPath source_;
    ZOR_Basis::FPath copy_;
    ZOR_Basis::FPath failedAt_;
    int files_ = 0;
};

#endif

/// \file
/// A folder of this run's own, which is also the root beneath which the library writes its reports.

#ifndef EXAMPLES_COPY_JOB_SCRATCH_ROOT_H
#define EXAMPLES_COPY_JOB_SCRATCH_ROOT_H

#include <zor_basis/files.h>

/// Made before the library first asks for the root, and removed with everything in it.
class ScratchRoot {
public:
    ScratchRoot();
    ~ScratchRoot();
    ScratchRoot(ScratchRoot const&) = delete;
    ScratchRoot& operator=(ScratchRoot const&) = delete;

    bool isMade() const { return made_; }
    ZOR_Basis::FPath const& path() const { return path_; }

private:
    ZOR_Basis::FPath path_;
    bool made_;
};

#endif

/// \file
/// What the listings of both systems have in common. Twins of dir_iter.cpp: dir_iter_win.cpp, dir_iter_posix.cpp.

#ifndef BASIS_FILES_DIR_ITER_H
#define BASIS_FILES_DIR_ITER_H

#include "zor_basis/files/dir_iterator.h"

namespace ZOR_Basis {

class SystemDirIterW : public DirIterImplW {
public:
    void finish() final;

protected:
    using DirIterImplW::DirIterImplW;

    /// Closes the system's listing, if one is open.
    virtual void close() = 0;
};

} // namespace ZOR_Basis

#endif

/// \file
/// `SysHdl`: a user who is logged on. `Sys::loginUser` creates it, the caller owns it, and deleting it logs the user
/// off.
///
/// \thread one thread at a time

#ifndef ZOR_BASIS_SYSTEM_SYS_HDL_H
#define ZOR_BASIS_SYSTEM_SYS_HDL_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

class ZB_API SysHdl {
public:
    SysHdl() = default;
    SysHdl(SysHdl const&) = delete;
    SysHdl& operator=(SysHdl const&) = delete;

    /// Tells whether the handle stands for a user; false in this base class.
    virtual bool isValid();
    virtual ~SysHdl();
};

} // namespace ZOR_Basis

#endif

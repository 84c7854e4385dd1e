#include "zor_basis/system/sys_hdl.h"

namespace ZOR_Basis {

bool SysHdl::isValid() { return false; }

SysHdl::~SysHdl() = default;

} // namespace ZOR_Basis

/// \file
/// Where log files lie.

#ifndef BASIS_LOG_LOG_PATH_H
#define BASIS_LOG_LOG_PATH_H

#include "zor_basis/files/f_path.h"

#include <cstdint>

namespace ZOR_Basis {

/// The folder of a log.
FPath logFolder(Str const& log);
/// The same, and makes it, with its parents, if it can.
FPath makeLogFolder(Str const& log);
/// The file of a session in the folder of its log.
FPath sessionFile(FPath const& folder, std::uint64_t session);

} // namespace ZOR_Basis

#endif

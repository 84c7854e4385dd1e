/// \file
/// Where log files lie.

#ifndef BASIS_LOG_LOG_PATH_H
#define BASIS_LOG_LOG_PATH_H

#include "zor_basis/files/f_path.h"

#include <cstdint>

namespace ZOR_Basis {

/// The file of a session of a log. \param makeFolders  make sure of the folders on the way
FPath logPath(Str const& log, std::uint64_t session, bool makeFolders);

} // namespace ZOR_Basis

#endif

#include "zor_basis/log/logger.h"

namespace ZOR_Basis {

Logger::~Logger() = default;

} // namespace ZOR_Basis

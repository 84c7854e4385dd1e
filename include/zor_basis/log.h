/// \file
/// Log files.

#ifndef ZOR_BASIS_LOG_H
#define ZOR_BASIS_LOG_H

#include "zor_basis/log/err.h"
#include "zor_basis/log/log.h"
#include "zor_basis/log/logger.h"

#endif

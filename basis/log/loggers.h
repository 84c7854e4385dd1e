/// \file
/// All loggers of the process.

#ifndef BASIS_LOG_LOGGERS_H
#define BASIS_LOG_LOGGERS_H

#include "basis/containers/linked_list.h"

#include <mutex>

namespace ZOR_Basis {

class LoggerImpl;

struct Loggers {
    std::mutex mutex;
    LinkedList<LoggerImpl> list;
};

/// Never destroyed: alerts go on while the process ends.
Loggers& loggers();

} // namespace ZOR_Basis

#endif

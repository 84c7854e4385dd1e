/// \file
/// `Logger`: the interface that a `Log` writes to.

#ifndef ZOR_BASIS_LOG_LOGGER_H
#define ZOR_BASIS_LOG_LOGGER_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

/// \thread thread-safe until it has been closed
class ZB_API Logger {
public:
    Logger() = default;
    Logger(Logger const&) = delete;
    Logger& operator=(Logger const&) = delete;

    /// Begins a new file for all lines that follow.
    virtual void newSession() = 0;
    /// Adds one line.
    /// \param line  has room for two characters behind the text, where the logger puts the end of the line and a
    ///     terminator
    virtual void out(char* line) = 0;
    /// Asks the logger to write its lines and then delete itself. The caller must not use it afterwards.
    virtual void close() = 0;
    virtual ~Logger();
};

} // namespace ZOR_Basis

#endif

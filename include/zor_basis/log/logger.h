/// \file
/// `Logger`: what a `Log` writes to.

#ifndef ZOR_BASIS_LOG_LOGGER_H
#define ZOR_BASIS_LOG_LOGGER_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

/// \thread  thread-safe until it has been closed
class ZB_API Logger {
public:
    Logger() = default;
    Logger(Logger const&) = delete;
    Logger& operator=(Logger const&) = delete;

    /// What follows goes to a file of its own.
    virtual void newSession() = 0;
    /// Adds one line.
    /// \param line  text with room for two characters behind it, where the logger puts the line's end and a terminator
    virtual void out(char* line) = 0;
    /// Asks the logger to write out what it has and to end itself. The caller forgets it.
    virtual void close() = 0;
    virtual ~Logger();
};

} // namespace ZOR_Basis

#endif

/// \file
/// `Err`: the entry points of an error log that is always off.

#ifndef ZOR_BASIS_LOG_ERR_H
#define ZOR_BASIS_LOG_ERR_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

/// Callers may keep their calls; the functions ignore their arguments and do nothing.
///
/// \thread thread-safe
class ZB_API Err {
public:
    /// Do nothing.
    static void err(char const* text);
    static void trace(char const* text);
};

} // namespace ZOR_Basis

#endif

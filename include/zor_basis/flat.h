/// \file
/// The plain functions, for callers that do not use the classes. C-clean, C linkage.

#ifndef ZOR_BASIS_FLAT_H
#define ZOR_BASIS_FLAT_H

#include "zor_basis/export.h"

/// A copy of a zero-terminated text in a block of its own.
/// \return the copy, owned by the caller, who releases it with the runtime's `free`; null for null, and where memory
///         is short
/// \thread any
ZB_EXTERN_C ZB_API char* ZB_StrDup(char const* text);

#endif

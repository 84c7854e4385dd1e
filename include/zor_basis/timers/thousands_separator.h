/// \file
/// The character that separates groups of three digits in reports, for the whole process.
///
/// \thread thread-safe

#ifndef ZOR_BASIS_TIMERS_THOUSANDS_SEPARATOR_H
#define ZOR_BASIS_TIMERS_THOUSANDS_SEPARATOR_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

/// The initial value is ","; 0 means that digits are not grouped.
ZB_API char thousandsSeparator();
ZB_API void setThousandsSeparator(char separator);

} // namespace ZOR_Basis

#endif

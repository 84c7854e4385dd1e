// The sibling is decimal_point_posix.cpp.

#include "basis/log/decimal_point.h"

#include <clocale>

namespace ZOR_Basis {

char const* decimalPoint() { return std::localeconv()->decimal_point; }

} // namespace ZOR_Basis

// The sibling is decimal_point_win.cpp.

#include "basis/log/decimal_point.h"

#include <langinfo.h>

namespace ZOR_Basis {

// Unlike `localeconv`, safe in any number of threads.
char const* decimalPoint() { return nl_langinfo(RADIXCHAR); }

} // namespace ZOR_Basis

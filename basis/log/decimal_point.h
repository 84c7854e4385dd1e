/// \file
/// The decimal point of the current locale: decimal_point_win.cpp, decimal_point_posix.cpp.

#ifndef BASIS_LOG_DECIMAL_POINT_H
#define BASIS_LOG_DECIMAL_POINT_H

namespace ZOR_Basis {

/// \return valid until the locale changes
char const* decimalPoint();

} // namespace ZOR_Basis

#endif

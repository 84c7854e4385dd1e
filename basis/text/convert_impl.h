/// \file
/// What the conversions ask of the system: convert_win.cpp, convert_posix.cpp.

#ifndef BASIS_TEXT_CONVERT_IMPL_H
#define BASIS_TEXT_CONVERT_IMPL_H

#include "zor_basis/text/convert.h"

namespace ZOR_Basis::ConvertImpl {

/// Whether two valid encodings are the same code page, so that text passes between them as it is.
bool samePage(Convert::Encoding a, Convert::Encoding b);

/// Converts `size` bytes, 1 to 2,147,483,647 of them, in a valid encoding into the empty `out`.
/// \return false, with an empty `out`, if the text is invalid
bool narrowToWide(Convert::Encoding from, char const* text, std::uint64_t size, WBStr& out);

/// Converts `size` units, 1 to 2,147,483,647 of them, to a valid encoding into the empty `out`.
/// \return false, with an empty `out`, if the system fails
bool wideToNarrow(WChar const* text, std::uint64_t size, Convert::Encoding to, BufStr<255>& out);

} // namespace ZOR_Basis::ConvertImpl

#endif

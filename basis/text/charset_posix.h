/// \file
/// The character set of the environment's locale, and conversions by it.

#ifndef BASIS_TEXT_CHARSET_POSIX_H
#define BASIS_TEXT_CHARSET_POSIX_H

#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/wb_str.h"

#include <cstdint>

namespace ZOR_Basis::Charset {

/// The set's name as the system's converter knows it; read from the environment once. Lives as long as the process.
char const* local();
/// Replaces the answer of `local()`; null goes back to the environment's. Not while another thread converts.
void setLocal(char const* name);

bool isUtf8(char const* charset);

/// Converts `size` bytes of the set into the empty `out`.
/// \return false, with an empty `out`, if the text is invalid
bool toWide(char const* charset, char const* text, std::uint64_t size, WBStr& out);
/// Converts `size` units to the set into the empty `out`, "?" for what it lacks.
/// \return false if there is no such set
bool fromWide(char const* charset, WChar const* text, std::uint64_t size, BufStr<255>& out);

} // namespace ZOR_Basis::Charset

#endif

/// \file
/// The 16-bit character of wide text.
///
/// `WChar` is the system's wide character on Windows and `char16_t` elsewhere: a UTF-16 code unit everywhere.
/// `ZB_W("text")` is a literal of it.

#ifndef ZOR_BASIS_WIDE_CHAR_H
#define ZOR_BASIS_WIDE_CHAR_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

/// A UTF-16 code unit, and a literal of them.
#ifdef _WIN32
using WChar = wchar_t;
#define ZB_W(text) L##text
#else
using WChar = char16_t;
#define ZB_W(text) u##text
#endif

static_assert(sizeof(WChar) == 2, "wide text is a sequence of 16-bit code units");

} // namespace ZOR_Basis

#endif

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

/// The place behind the last slash, of either kind.
/// \return a pointer into the text; null without a slash and for null
/// \thread any
ZB_EXTERN_C ZB_API char const* ZB_baseNamePosition(char const* text);

/// Turns every "\" into "/", in place. Null does nothing.
/// \thread any
ZB_EXTERN_C ZB_API void ZB_replaceBackSlashes(char* text);

/// Copies a text with every "\" turned into "/", terminator included.
/// \pre neither is null; `target` has room for the whole text and may be the source itself
/// \thread any
ZB_EXTERN_C ZB_API void ZB_replaceBackSlashes2(char const* source, char* target);

/// Writes a text with its percent escapes decoded, terminator included. The two characters behind a "%" are always
/// taken, one that is no hexadecimal digit as 0: "%g1" gives the byte 1, and "%zz" a zero, which ends the text for
/// whoever reads it as one. "+" stays "+".
/// \param out  room for as many bytes as the source has; may be the source itself
/// \pre a "%" has two characters behind it: where it is among the last two bytes of the text, the terminator is taken
///      for a digit and what lies behind it is read and decoded
/// \return 0, without a meaning
/// \thread any
ZB_EXTERN_C ZB_API int ZB_resolveURIEscapes(char const* in, char* out);

#endif

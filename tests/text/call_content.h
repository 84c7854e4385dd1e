/// \file
/// The content of a text after a call.

#ifndef TESTS_TEXT_CALL_CONTENT_H
#define TESTS_TEXT_CALL_CONTENT_H

#include "zor_basis/text/str.h"

#include <string>

/// The bytes of any narrow text, its terminator excluded.
inline std::string contentOfAny(ZOR_Basis::Str const& text) { return {text.c_str(), text.size()}; }

#endif

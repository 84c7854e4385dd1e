/// \file
/// Helpers of the tests of conversions.

#ifndef TESTS_TEXT_CONVERT_CHECK_H
#define TESTS_TEXT_CONVERT_CHECK_H

#include <zor_basis/text/convert.h>

#include "tests/text/reference_utf.h"

#include <string>

inline std::string bytesOf(ZOR_Basis::BufStr<255> const& text) { return {text.c_str(), text.size()}; }
inline reference::WideText unitsOf(ZOR_Basis::WBStr const& text) { return {text.wstr(), text.size()}; }

inline ZOR_Basis::Convert::Encoding encoding(std::uint32_t value) {
    return static_cast<ZOR_Basis::Convert::Encoding>(value);
}

/// An output with a previous content on the heap, which shows whether a function empties its output.
template <class Text>
Text filled() {
    Text text;
    for (int i = 0; i < 300; ++i) text += 'x';
    return text;
}

#endif

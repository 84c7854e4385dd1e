/// \file
/// Copying parts of texts, which may be empty: to the strings a length of 0 means the whole text.

#ifndef BASIS_SYSTEM_TEXT_PARTS_H
#define BASIS_SYSTEM_TEXT_PARTS_H

#include "zor_basis/text/buf_str.h"

#include <cstdint>

namespace ZOR_Basis {

template <std::uint64_t N>
void setPart(BufStr<N>& out, char const* begin, char const* end) {
    out.clear();
    if (begin != end) out.add(begin, static_cast<std::uint64_t>(end - begin));
}

/// The bytes of a view, all of which may be read, up to a terminator among them.
template <std::uint64_t N>
void setBounded(BufStr<N>& out, char const* text, std::uint64_t limit) {
    setPart(out, text, text + (limit != 0 ? detail::textLengthUpTo(text, limit) : 0));
}

} // namespace ZOR_Basis

#endif

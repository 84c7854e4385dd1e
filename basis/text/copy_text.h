/// \file
/// Copying up to a terminator and padding with zeros, a step at a time. Works for every source and every overlap.

#ifndef BASIS_TEXT_COPY_TEXT_H
#define BASIS_TEXT_COPY_TEXT_H

#include "zor_basis/text/char_ops.h"

#include <cstring>

namespace ZOR_Basis::detail {

template <class Char>
void copyUpToTerminator(Char* target, Char const* source, std::uint64_t length) noexcept {
    if (length == 0) return;
    std::uint64_t const copied = textLengthUpTo(source, length);
    std::memmove(target, source, copied * sizeof(Char));
    std::memset(target + copied, 0, (length - copied) * sizeof(Char));
}

} // namespace ZOR_Basis::detail

#endif

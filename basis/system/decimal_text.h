/// \file
/// Counting in a text.

#ifndef BASIS_SYSTEM_DECIMAL_TEXT_H
#define BASIS_SYSTEM_DECIMAL_TEXT_H

#include "zor_basis/text/buf_str.h"

namespace ZOR_Basis {

/// Adds 1 to a number of any length in decimal digits.
inline void incrementDecimal(BufStr<15>& digits) {
    for (std::uint64_t i = digits.size(); i > 0; --i) {
        char& digit = digits[i - 1];
        if (digit != '9') {
            ++digit;
            return;
        }
        digit = '0';
    }
    digits.insert(0, "1");
}

} // namespace ZOR_Basis

#endif

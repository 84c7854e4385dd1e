/// \file
/// How far a conversion to UTF-8 has come.

#ifndef BASIS_TEXT_UTF16_PROGRESS_H
#define BASIS_TEXT_UTF16_PROGRESS_H

#include "zor_basis/wide_char.h"

#include <cstdint>

namespace ZOR_Basis::Utf {

/// What is left to read, and the room that is left to write.
struct Progress {
    WChar const* begin;
    WChar const* text;
    WChar const* end;
    char* out;
    char* outEnd;
    bool hasZero = false; ///< whether a zero was among the units

    std::uint64_t done() const { return static_cast<std::uint64_t>(text - begin); }
    std::uint64_t left() const { return static_cast<std::uint64_t>(end - text); }
    std::uint64_t room() const { return static_cast<std::uint64_t>(outEnd - out); }
    void advance(std::uint64_t units, std::uint64_t bytes) {
        text += units;
        out += bytes;
    }
};

} // namespace ZOR_Basis::Utf

#endif

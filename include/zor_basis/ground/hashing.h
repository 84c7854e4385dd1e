/// \file
/// The hash of texts, and integer functions for table sizes.
///
/// \thread thread-safe

#ifndef ZOR_BASIS_GROUND_HASHING_H
#define ZOR_BASIS_GROUND_HASHING_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

/// The djb2 hash: beginning with 5381, for each byte before the terminator multiply by 33 and add the byte, modulo
/// 2^64.
/// \param text  is zero-terminated; null hashes like the empty text, to 5381
/// \param length  is ignored: a text with an inner zero byte is hashed only up to that byte
/// \kept hash-01: bytes are signed, so 0x80 to 0xFF subtract (0xE9 adds -23); stored hashes depend on it
ZB_API std::uint64_t hashDjb2(char const* text, std::uint64_t length) noexcept;

/// The floor of the binary logarithm; 0 for 0.
ZB_API std::uint64_t Log2(std::uint64_t n) noexcept;

/// 2^i.
/// \pre i is at most 30
ZB_API std::uint64_t Pow2(std::uint64_t i) noexcept;

/// The largest prime that is not above 2^i; 1 for i = 0.
/// \pre i is at most 30
ZB_API std::uint64_t PrimeClsPo2(std::uint64_t i) noexcept;

/// The floor of the square root.
/// \kept hash-02: only the low 32 bits are used, as a signed number; from 2^31 on the result is meaningless
ZB_API std::uint64_t sqrtInt(std::uint64_t n) noexcept;

} // namespace ZOR_Basis

#endif

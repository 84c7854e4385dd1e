/// \file
/// The hash of texts.

#ifndef ZOR_BASIS_CONTAINERS_HASHING_H
#define ZOR_BASIS_CONTAINERS_HASHING_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

/// The djb2 hash: from 5381 on, times 33 plus the byte, modulo 2^64, over the bytes before the terminator.
/// \param text    zero-terminated; null hashes as the empty text, to 5381
/// \param length  not looked at: a text with an inner zero byte is hashed up to that byte only
/// \kept hash-01: bytes are signed, so 0x80 to 0xFF take away (0xE9 adds -23); stored hashes depend on it
/// \thread any
ZB_API std::uint64_t hashDjb2(char const* text, std::uint64_t length) noexcept;

} // namespace ZOR_Basis

#endif

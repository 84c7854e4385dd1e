/// \file
/// The ways to hash a text that the processor decides between.

#ifndef BASIS_GROUND_HASH_DJB2_H
#define BASIS_GROUND_HASH_DJB2_H

#include <cstdint>

namespace ZOR_Basis {

/// `hashDjb2` of a text that is not null, on processors without SSSE3.
std::uint64_t hashDjb2ByMultiplication(char const* text);

} // namespace ZOR_Basis

#endif

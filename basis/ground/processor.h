/// \file
/// Which vector instructions the kernels use.

#ifndef BASIS_GROUND_PROCESSOR_H
#define BASIS_GROUND_PROCESSOR_H

#include "zor_basis/ground/compiler.h"

namespace ZOR_Basis::detail {

/// Each set of instructions includes the ones before it.
enum class Vectors : unsigned char { SSE2, SSSE3, AVX2 };

/// The best set that both the processor and the compiler support. Kernels choose by it. Tests and benchmarks may lower
/// it, to run the kernels of other processors.
ZB_HIDDEN extern Vectors usableVectors;

inline bool canUse(Vectors set) noexcept { return usableVectors >= set; }

} // namespace ZOR_Basis::detail

#endif

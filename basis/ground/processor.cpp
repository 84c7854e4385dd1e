#include "basis/ground/processor.h"

namespace ZOR_Basis::detail {

namespace {

Vectors bestVectors() noexcept {
    if (ZB_HAS_AVX2) return Vectors::AVX2;
    return ZB_HAS_SSSE3 ? Vectors::SSSE3 : Vectors::SSE2;
}

} // namespace

// Until it is initialised it is SSE2, which every processor has.
Vectors usableVectors = bestVectors();

} // namespace ZOR_Basis::detail

// The main function of benchmarks that hold the library's objects: kernels use no vectors above those that the variable
// BENCH_VECTORS names, one of sse2, ssse3 and avx2.

#include "basis/ground/processor.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <string_view>

namespace {

using ZOR_Basis::detail::Vectors;

bool lowerVectors(std::string_view name) {
    for (auto const& [known, vectors] :
         {std::pair{"sse2", Vectors::SSE2}, std::pair{"ssse3", Vectors::SSSE3}, std::pair{"avx2", Vectors::AVX2}}) {
        if (name != known) continue;
        ZOR_Basis::detail::usableVectors = std::min(ZOR_Basis::detail::usableVectors, vectors);
        return true;
    }
    return false;
}

} // namespace

int main(int count, char** arguments) {
    char const* const wanted = std::getenv("BENCH_VECTORS");
    if (wanted == nullptr || !lowerVectors(wanted)) {
        std::fprintf(stderr, "BENCH_VECTORS must be sse2, ssse3 or avx2\n");
        return 2;
    }
    benchmark::Initialize(&count, arguments);
    if (benchmark::ReportUnrecognizedArguments(count, arguments)) return 2;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}

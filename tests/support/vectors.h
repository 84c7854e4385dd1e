/// \file
/// Runs a test with each set of vector instructions that kernels choose from.

#ifndef TESTS_SUPPORT_VECTORS_H
#define TESTS_SUPPORT_VECTORS_H

#include "basis/ground/processor.h"
#include "tests/support/skip.h"

#include <gtest/gtest.h>

/// A test for one set: nothing above it is used while the test runs.
class EachVectors : public testing::TestWithParam<ZOR_Basis::detail::Vectors> {
protected:
    void SetUp() override {
        if (GetParam() > best_) CASE_CANNOT_HOLD("the processor lacks these vectors");
        ZOR_Basis::detail::usableVectors = GetParam();
    }
    void TearDown() override { ZOR_Basis::detail::usableVectors = best_; }

private:
    ZOR_Basis::detail::Vectors best_ = ZOR_Basis::detail::usableVectors;
};

inline char const* nameOf(ZOR_Basis::detail::Vectors vectors) {
    static constexpr char const* NAMES[] = {"sse2", "ssse3", "avx2"};
    return NAMES[static_cast<unsigned>(vectors)];
}

/// Defines the tests of a suite that is derived from `EachVectors`.
#define INSTANTIATE_FOR_EACH_VECTORS(Suite)                                                                            \
    INSTANTIATE_TEST_SUITE_P(Vectors, Suite,                                                                           \
                             testing::Values(ZOR_Basis::detail::Vectors::SSE2, ZOR_Basis::detail::Vectors::SSSE3,      \
                                             ZOR_Basis::detail::Vectors::AVX2),                                        \
                             [](auto const& set) { return nameOf(set.param); })

#endif

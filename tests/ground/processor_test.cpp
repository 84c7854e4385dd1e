#include "basis/ground/processor.h"

#include "zor_basis/ground/compiler.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis::detail;

TEST(Processor, offers_the_best_vectors_that_it_has) {
    EXPECT_EQ(canUse(Vectors::AVX2), ZB_HAS_AVX2);
    EXPECT_EQ(canUse(Vectors::SSSE3), ZB_HAS_SSSE3);
    EXPECT_TRUE(canUse(Vectors::SSE2));
}

TEST(Processor, offers_nothing_above_what_is_set) {
    Vectors const best = usableVectors;
    for (Vectors const set : {Vectors::SSE2, Vectors::SSSE3, Vectors::AVX2}) {
        usableVectors = set;
        EXPECT_TRUE(canUse(set));
        EXPECT_EQ(canUse(Vectors::SSSE3), set != Vectors::SSE2);
        EXPECT_EQ(canUse(Vectors::AVX2), set == Vectors::AVX2);
    }
    usableVectors = best;
}

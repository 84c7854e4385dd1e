// Applies random operations to a list and to a plain vector.

#include "tests/containers/sng_list_steps.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <random>

using namespace ZOR_Basis;

TEST(SngListModel, stays_what_a_plain_vector_is) {
    sng_list::ListBesideVector<std::mt19937_64> b(randomSource());
    for (std::uint64_t step = randomSteps(100'000); step > 0; --step) {
        auto const& operation = drawn(sng_list::OPERATIONS<decltype(b)>, b.random);
        operation.act(b);
        ASSERT_TRUE(b.agree()) << operation.name;
    }
}

// Applies random operations to BufStr<15>, BufStr<255> and WBStr and to their model.

#include "tests/support/random_steps.h"
#include "tests/text/inline_text_steps.h"

#include <gtest/gtest.h>

#include <random>

using namespace ZOR_Basis;

namespace {

template <class String>
class InlineTextModel : public testing::Test {};

} // namespace

using ModelledKinds = testing::Types<BufStr<15>, BufStr<255>, WBStr>;
TYPED_TEST_SUITE(InlineTextModel, ModelledKinds, );

TYPED_TEST(InlineTextModel, agrees_after_every_random_operation) {
    inline_text::InlineTextBesideModel<TypeParam, std::mt19937_64> b(randomSource());
    std::uint64_t const steps = randomSteps(1'000'000);
    for (std::uint64_t step = 0; step < steps; ++step) {
        auto const& operation = drawnFor(b);
        operation.act(b);
        ASSERT_TRUE(b.agree()) << operation.name << " at step " << step;
    }
}

#include "basis/memory/never_destroyed.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct Mortal {
    Mortal(int* counter, int n) : deaths(counter), number(n) {}
    ~Mortal() { ++*deaths; }

    int* deaths;
    int number;
};

} // namespace

TEST(NeverDestroyed, is_made_of_its_arguments_and_outlives_its_scope) {
    int deaths = 0;
    {
        NeverDestroyed<Mortal> mortal(&deaths, 7);
        EXPECT_EQ((*mortal).number, 7);
        (*mortal).number = 8;
        EXPECT_EQ((*mortal).number, 8);
    }
    EXPECT_EQ(deaths, 0);
}

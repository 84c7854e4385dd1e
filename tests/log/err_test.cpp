#include <zor_basis/log.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(Err, does_nothing) {
    for (char const* text : {"text", "%s%n", "", static_cast<char const*>(nullptr)}) {
        Err::err(text);
        Err::trace(text);
    }
}

#include "basis/platform/xos_basics.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

namespace {

int sign(int number) { return number < 0 ? -1 : static_cast<int>(number > 0); }

TEST(HostStrCmp, compares_bytes) {
    struct Case {
        Row row;
        char const* a;
        char const* b;
        int expected;
    };
    for (Case const& c : {Case{{}, "", "", 0}, Case{{}, "abc", "abc", 0}, Case{{}, "abc", "abd", -1},
                          Case{{}, "abc", "ab", 1}, Case{{}, "a", "A", 1}, Case{{}, "\x80", "a", 1},
                          Case{{}, nullptr, nullptr, 0}, Case{{}, nullptr, "", -1}, Case{{}, "", nullptr, 1}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(sign(xos_StrCmp(c.a, c.b)), c.expected);
    }
}

} // namespace

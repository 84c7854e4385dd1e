#include "tools/zbtool/progress.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

using namespace zbtool;

namespace {

constexpr std::uint64_t MIB = 1 << 20;

TEST(Progress, tells_sizes_in_units_that_read_well) {
    struct Case {
        Row row;
        std::uint64_t bytes;
        char const* expected;
    };
    Case const cases[] = {
        {{}, 0, "0 bytes"},         {{}, 1023, "1023 bytes"},
        {{}, 1024, "1.0 KiB"},      {{}, 1536, "1.5 KiB"},
        {{}, MIB, "1.0 MiB"},       {{}, 5 * MIB / 2, "2.5 MiB"},
        {{}, MIB << 10, "1.0 GiB"}, {{}, ~std::uint64_t{0}, "16.0 EiB"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(sizeText(c.bytes), c.expected);
    }
}

TEST(Progress, tells_what_is_done_and_what_is_left_where_the_total_is_known) {
    struct Case {
        Row row;
        Amount done, total;
        double seconds;
        char const* expected;
    };
    Case const cases[] = {
        {{}, {0, 0}, {}, 0, "copying  0 entries, 0 bytes"},
        {{}, {3, 2 * MIB}, {}, 4, "copying  3 entries, 2.0 MiB, 512.0 KiB/s"},
        {{}, {3, MIB}, {10, 4 * MIB}, 2, "copying  3 of 10 entries, 1.0 MiB of 4.0 MiB, 512.0 KiB/s, 0:06 left"},
        {{}, {10, MIB}, {40, 0}, 30, "copying  10 of 40 entries, 1.0 MiB of 0 bytes, 34.1 KiB/s, 1:30 left"},
        {{}, {0, 0}, {10, 4 * MIB}, 2, "copying  0 of 10 entries, 0 bytes of 4.0 MiB, 0 bytes/s"},
        {{}, {12, 5 * MIB}, {10, 4 * MIB}, 1, "copying  12 of 10 entries, 5.0 MiB of 4.0 MiB, 5.0 MiB/s"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(progressText("copying", c.done, c.total, c.seconds), c.expected);
    }
}

} // namespace

#include "tests/log/line_check.h"
#include "tests/support/skip.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cfenv>
#include <cfloat>
#include <climits>
#include <cmath>
#include <cstdint>
#include <limits>

using namespace ZOR_Basis;

namespace {

constexpr double INFINITE = std::numeric_limits<double>::infinity();

} // namespace

TEST(LineText, breathes) {
    Written const written = writtenWith(ROOM, "page %d of %s took %.3f s", 7, "book", 0.0625);
    EXPECT_EQ(written.ours, "page 7 of book took 0.062 s");
    EXPECT_TRUE(written.quickly);
}

TEST(LineText, goes_the_short_way_for_what_lines_consist_of) {
    EXPECT_TRUE(check(""));
    EXPECT_TRUE(check("no conversion at all"));
    EXPECT_TRUE(check("100%%, %%d %%%%"));
    for (char const* format : {"%d", "%i", "%5d", "%-5d|", "%05d", "%+d", "% d", "%+05d", "%-+7d|", "%-05d|", "%x",
                               "%o", "%u", "%08x", "%hhd", "%hd", "%hhu", "%hu", "%2d"}) {
        for (int value : {0, 1, -1, 9, 10, 99, 100, 127, 128, 255, 256, -128, 32767, 32768, 65536, INT_MAX, INT_MIN}) {
            EXPECT_TRUE(check(format, value)) << format;
        }
    }
    for (char const* format : {"%ld", "%lu", "%lx", "%20ld", "%-20lu|"}) {
        for (long value : {0L, 1L, -1L, LONG_MAX, LONG_MIN}) EXPECT_TRUE(check(format, value)) << format;
    }
    for (char const* format : {"%lld", "%llu", "%llx", "%llo", "%jd", "%ju", "%zu", "%zd", "%td", "%025lld"}) {
        for (long long value : {0LL, 1LL, -1LL, LLONG_MAX, LLONG_MIN, 1'000'000'000'000LL}) {
            EXPECT_TRUE(check(format, value)) << format;
        }
    }
    for (char const* format : {"%s", "%5s|", "%-5s|", "%.2s", "%.0s|", "%.s|", "%8.3s|", "%-8.3s|", "%.9s"}) {
        for (char const* text : {"", "a", "abc", "abcdefghij", "%d"}) EXPECT_TRUE(check(format, text)) << format;
    }
    for (char const* format : {"%c", "%3c|", "%-3c|"}) {
        for (int c : {0x41, 0x25, 200, 300, -1}) EXPECT_TRUE(check(format, c)) << format;
    }
}

namespace {

constexpr double FIXED_DECIMALS[] = {0.0,
                                     -0.0,
                                     1.0,
                                     -1.0,
                                     0.5,
                                     1.5,
                                     2.5,
                                     3.5,
                                     -0.5,
                                     -2.5,
                                     0.125,
                                     0.375,
                                     0.0625,
                                     0.1,
                                     0.2,
                                     0.3,
                                     0.005,
                                     0.015,
                                     0.025,
                                     1.005,
                                     2.675,
                                     0.9994999,
                                     0.9995,
                                     0.99951,
                                     9.9995,
                                     99.5,
                                     999.9996,
                                     0.0004999,
                                     0.0005,
                                     0.00051,
                                     1e-3,
                                     1e-5,
                                     1e-10,
                                     1e-19,
                                     5e-20,
                                     4.9e-20,
                                     1e-300,
                                     5e-324,
                                     DBL_MIN,
                                     DBL_EPSILON,
                                     1e6,
                                     123456.789,
                                     1e15,
                                     4503599627370495.5,
                                     4503599627370496.5,
                                     9007199254740993.0,
                                     1e18,
                                     9.2e18,
                                     9223372036854774784.0,
                                     0.3333333333333333,
                                     1 / 3e9,
                                     3.141592653589793,
                                     2.718281828459045e-4,
                                     4.8828125e-4,
                                     2.44140625e-4};

} // namespace

TEST(LineText, rounds_fixed_decimals_as_exactly_as_printf) {
    for (char const* format : {"%f", "%.0f", "%.1f", "%.2f", "%.3f", "%.6f", "%.9f", "%.15f", "%.18f", "%.19f", "%lf",
                               "%.f", "%10.3f", "%-10.3f|", "%010.3f", "%+.3f", "% .3f", "%+010.2f", "%5.0f"}) {
        for (double value : FIXED_DECIMALS) {
            EXPECT_TRUE(check(format, value)) << format << " of " << value;
            EXPECT_TRUE(check(format, -value)) << format << " of " << -value;
        }
    }
}

TEST(LineText, goes_the_long_way_for_everything_else) {
    struct Case {
        Row row;
        char const* format;
        double value;
    };
    for (Case const& c : {Case{{}, "%f", INFINITE}, Case{{}, "%.3f", -INFINITE}, Case{{}, "%f", std::nan("")},
                          Case{{}, "%010f", INFINITE}, Case{{}, "%.3f", 9223372036854775808.0}, Case{{}, "%.3f", 1e300},
                          Case{{}, "%.20f", 0.1}, Case{{}, "%.40f", 0.1}, Case{{}, "%e", 12.5}, Case{{}, "%g", 1e-9},
                          Case{{}, "%a", 1.0}, Case{{}, "%F", 1.5}, Case{{}, "%#.0f", 1.0}, Case{{}, "%G", 1e20}}) {
        SCOPED_TRACE(c.row);
        EXPECT_FALSE(check(c.format, c.value));
    }
    EXPECT_FALSE(check("%Lf", 1.25L));
    for (char const* format : {"%.3d", "%.0d", "%#x", "%X", "%#o", "%+u", "% x"}) {
        for (int value : {0, 1, -1, 255}) EXPECT_FALSE(check(format, value)) << format;
    }
    EXPECT_FALSE(check("%*d|", 7, 5));
    EXPECT_FALSE(check("%-*d|", 7, 5));
    EXPECT_FALSE(check("%.*f|", 2, 5.125));
    EXPECT_FALSE(check("%.*s|", 2, "abc"));
    EXPECT_FALSE(check("%p", static_cast<void const*>("x")));
    for (char const* format : {"%s|", "%.3s|", "%10s|"}) {
        EXPECT_FALSE(check(format, static_cast<char const*>(nullptr))) << format;
    }
    EXPECT_FALSE(check("%ls", L"wide"));
    EXPECT_FALSE(check("%lc", static_cast<wint_t>(L'w')));
    EXPECT_FALSE(check("%d %s %e", 5, "text", 0.5)) << "arguments are read again from the first";
    EXPECT_FALSE(check("%12345d", 1)) << "a width beyond the room";
}

TEST(LineText, counts_what_has_been_written_so_far) {
    int ours = 0;
    std::string const text = writtenWith(ROOM, "abc%n%d", &ours, 5).ours;
    if (text != "abc5") CASE_CANNOT_HOLD("this runtime knows no %n");
    EXPECT_EQ(ours, 3);
}

TEST(LineText, writes_nothing_behind_its_room_wherever_that_ends) {
    for (std::size_t room = 1; room <= 100; ++room) {
        SCOPED_TRACE(room);
        EXPECT_EQ(writtenWith(room, "%-30s|%d", "text", -77).ours, printed(room, "%-30s|%d", "text", -77));
        EXPECT_EQ(writtenWith(room, "%30s%%", "text").ours, printed(room, "%30s%%", "text"));
        EXPECT_EQ(writtenWith(room, "%-40c|", 'a').ours, printed(room, "%-40c|", 'a'));
        EXPECT_EQ(writtenWith(room, "a%50d|", -12345).ours, printed(room, "a%50d|", -12345));
        EXPECT_EQ(writtenWith(room, "a%050d|", -12345).ours, printed(room, "a%050d|", -12345));
        EXPECT_EQ(writtenWith(room, "a%-50d|", 12345).ours, printed(room, "a%-50d|", 12345));
        EXPECT_EQ(writtenWith(room, "%lo", ~0UL).ours, printed(room, "%lo", ~0UL));
        EXPECT_EQ(writtenWith(room, "%.9f|%x", -4e15, 255).ours, printed(room, "%.9f|%x", -4e15, 255));
    }
}

TEST(LineText, is_cut_where_the_room_ends) {
    std::string const text(2000, 'x');
    for (std::size_t room : {1u, 2u, 3u, 5u, 8u, 1023u}) {
        for (char const* format : {"%s", "%d%s", "abcdefgh%d%s"}) {
            SCOPED_TRACE(format);
            if (*format == '%' && format[1] == 's') {
                EXPECT_EQ(writtenWith(room, format, text.c_str()).ours, printed(room, format, text.c_str()));
            } else {
                EXPECT_EQ(writtenWith(room, format, 123456, text.c_str()).ours,
                          printed(room, format, 123456, text.c_str()));
            }
        }
        EXPECT_EQ(writtenWith(room, "%5c|", 'a').ours, printed(room, "%5c|", 'a'));
        EXPECT_EQ(writtenWith(room, "%.3f|", 12.5).ours, printed(room, "%.3f|", 12.5));
        EXPECT_EQ(writtenWith(room, "abcdefghijkl").ours, printed(room, "abcdefghijkl"));
    }
    for (std::size_t size = ROOM - 4; size < ROOM + 4; ++size) {
        std::string const fitting(size, 'y');
        Written const written = writtenWith(ROOM, "%s", fitting.c_str());
        EXPECT_EQ(written.ours, fitting.substr(0, ROOM - 1));
        EXPECT_EQ(written.quickly, size < ROOM);
    }
}

TEST(LineText, follows_the_rounding_mode) {
    for (int mode : {FE_UPWARD, FE_DOWNWARD, FE_TOWARDZERO, FE_TONEAREST}) {
        if (std::fesetround(mode) != 0) continue;
        for (double value : {0.125, 0.1, -0.1, 2.5, -2.5, 1e-9}) {
            char const* format = "%.2f";
            Written const written = writtenWith(ROOM, format, value);
            std::string const expected = printed(ROOM, format, value);
            std::fesetround(FE_TONEAREST);
            EXPECT_EQ(written.ours, expected) << value << " in mode " << mode;
            EXPECT_EQ(written.quickly, mode == FE_TONEAREST);
            std::fesetround(mode);
        }
        std::fesetround(FE_TONEAREST);
    }
}

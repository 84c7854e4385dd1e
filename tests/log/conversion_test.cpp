#include "basis/log/conversion.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

struct Read {
    Row row;
    char const* text;
    std::string flags;
    std::size_t width;
    int precision;
    Conversion::Length length;
    char kind;
    char const* rest;
};

Read const READ[] = {
    {{}, "d", "", 0, -1, Conversion::NONE, 'd', ""},
    {{}, "d and more", "", 0, -1, Conversion::NONE, 'd', " and more"},
    {{}, "-08.3fx", "-0", 8, 3, Conversion::NONE, 'f', "x"},
    {{}, "+ d", "+ ", 0, -1, Conversion::NONE, 'd', ""},
    {{}, " --+5u", "-+ ", 5, -1, Conversion::NONE, 'u', ""},
    {{}, ".f", "", 0, 0, Conversion::NONE, 'f', ""},
    {{}, ".12s", "", 0, 12, Conversion::NONE, 's', ""},
    {{}, "hhd", "", 0, -1, Conversion::CHAR, 'd', ""},
    {{}, "hd", "", 0, -1, Conversion::SHORT, 'd', ""},
    {{}, "ld", "", 0, -1, Conversion::LONG, 'd', ""},
    {{}, "lld", "", 0, -1, Conversion::LONG_LONG, 'd', ""},
    {{}, "zu", "", 0, -1, Conversion::SIZE, 'u', ""},
    {{}, "jx", "", 0, -1, Conversion::MAXIMUM, 'x', ""},
    {{}, "ti", "", 0, -1, Conversion::DIFFERENCE, 'i', ""},
    {{}, "%", "", 0, -1, Conversion::NONE, '%', ""},
    {{}, "#x", "", 0, -1, Conversion::NONE, '#', "x"}, // a flag that is not known ends it
    {{}, "9999d", "", 9999, -1, Conversion::NONE, 'd', ""},
    {{}, "", "", 0, -1, Conversion::NONE, '\0', ""},
    {{}, "5", "", 5, -1, Conversion::NONE, '\0', ""},
    {{}, "l", "", 0, -1, Conversion::LONG, '\0', ""},
};

std::string flagsOf(Conversion const& conversion) {
    std::string flags;
    if (conversion.isLeft) flags += '-';
    if (conversion.hasZeros) flags += '0';
    if (conversion.hasPlus) flags += '+';
    if (conversion.hasBlank) flags += ' ';
    return flags;
}

} // namespace

TEST(Conversion, is_read_in_its_parts) {
    for (Read const& c : READ) {
        SCOPED_TRACE(c.row);
        Conversion conversion;
        EXPECT_STREQ(conversion.read(c.text), c.rest);
        EXPECT_EQ(flagsOf(conversion), c.flags);
        EXPECT_EQ(conversion.width, c.width);
        EXPECT_EQ(conversion.precision, c.precision);
        EXPECT_EQ(conversion.length, c.length);
        EXPECT_EQ(conversion.kind, c.kind);
    }
}

TEST(Conversion, reads_no_number_without_end) {
    Conversion conversion;
    std::string const digits(1000, '9');
    conversion.read(digits.c_str());
    EXPECT_GT(conversion.width, std::size_t{Conversion::LARGEST_NUMBER});
    EXPECT_LT(conversion.width, 10u * Conversion::LARGEST_NUMBER + 10);
}

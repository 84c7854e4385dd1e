#include "basis/system/decimal_text.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

TEST(DecimalText, counts) {
    BufStr<15> text("0");
    for (int i = 1; i <= 12'345; ++i) {
        incrementDecimal(text);
        ASSERT_EQ(std::string(text.c_str()), std::to_string(i));
        ASSERT_EQ(text.size(), std::to_string(i).size());
    }
}

TEST(DecimalText, carries) {
    struct Case {
        Row row;
        char const *before, *after;
    };
    for (Case const& c : {
             Case{{}, "9", "10"},
             Case{{}, "99", "100"},
             Case{{}, "109", "110"},
             Case{{}, "199", "200"},
             Case{{}, "1999", "2000"},
             Case{{}, "00", "01"},
             Case{{}, "", "1"},
             Case{{}, "99999999999999", "100000000000000"},
             Case{{}, "999999999999999", "1000000000000000"},
             Case{{}, "18446744073709551615", "18446744073709551616"},
             Case{{}, "99999999999999999999", "100000000000000000000"},
         }) {
        SCOPED_TRACE(c.row);
        BufStr<15> text(c.before);
        incrementDecimal(text);
        EXPECT_STREQ(text.c_str(), c.after);
    }
}

#include <zor_basis/timers.h>

#include "tests/timers/opened.h"
#include "tests/timers/report_model.h"
#include "tests/timers/separator.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(ThousandsSeparator, is_a_comma_unless_set) {
    EXPECT_EQ(thousandsSeparator(), ',');
    OpenedPile pile("stage", true);
    pileUp(pile, OpenedPile::frequency() * 1'234'567);
    BufStr<255> line;
    for (char separator : {'.', ' ', '\0'}) {
        Separator const set(separator);
        EXPECT_EQ(thousandsSeparator(), separator);
        pile.print(line, 1);
        EXPECT_EQ(bytesOfRow(line), modelRow("stage", measuredOnce(1'234'567), separator));
    }
}

// Compares the rows of piles with those of the plain model.

#include <zor_basis/timers.h>

#include "tests/timers/opened.h"
#include "tests/timers/report_model.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

TEST(PileTimerPrint, makes_a_row_of_any_line) {
    OpenedPile pile("stage", true);
    pileUp(pile, OpenedPile::frequency() * 3);
    std::string const expected = modelRow("stage", measuredOnce(3), ',');
    for (std::string const& before : {std::string(), std::string("x"), std::string(156, 'x'), std::string(1000, 'x')}) {
        BufStr<255> line(before);
        pile.print(line, 1);
        EXPECT_EQ(bytesOfRow(line), expected);
        pile.print(line, 1);
        EXPECT_EQ(bytesOfRow(line), expected);
    }
}

TEST(PileTimerPrint, has_no_numbers_but_0_where_nothing_was_measured) {
    BufStr<255> line;
    PileTimer("never", true).print(line, 1'000'000);
    EXPECT_EQ(bytesOfRow(line), "never" + std::string(43, ' ') + "0" + std::string(107, ' '));
}

TEST(PileTimerPrint, Kept_timers_06_has_a_zero_byte_at_154_and_a_space_behind_it) {
    OpenedPile pile("stage", true);
    pileUp(pile, 1);
    BufStr<255> line;
    pile.print(line, 1'000'000);
    ASSERT_EQ(line.size(), 156u);
    EXPECT_EQ(line.c_str()[153], '0');
    EXPECT_EQ(line.c_str()[154], '\0');
    EXPECT_EQ(line.c_str()[155], ' ');
}

TEST(PileTimerPrint, Kept_timers_07_lets_a_long_name_run_into_the_columns) {
    std::string const name(150, 'n');
    OpenedPile pile(name.c_str(), true);
    BufStr<255> line;
    pile.print(line, 1'000'000);
    EXPECT_EQ(bytesOfRow(line), std::string(48, 'n') + "0" + std::string(101, 'n') + "      ");
    OpenedPile const longer(std::string(200, 'n').c_str(), true);
    longer.print(line, 1'000'000);
    EXPECT_EQ(bytesOfRow(line), std::string(48, 'n') + "0" + std::string(107, 'n')) << "no further than the row";
    pile.setId(3);
    pileUp(pile, OpenedPile::frequency() * 12'345);
    pile.print(line, 1);
    EXPECT_EQ(bytesOfRow(line).substr(40, 30), "nnnnnnnn1nnnnnnnnn12,345nnnnnn");
}

TEST(PileTimerPrint, averages_with_signs) {
    OpenedPile pile("stage", true);
    pileUp(pile, -OpenedPile::frequency() * 7);
    pileUp(pile, 0);
    BufStr<255> line;
    pile.print(line, 1);
    EXPECT_EQ(bytesOfRow(line), modelRow("stage", {.count = 2, .total = -7, .average = -3, .min = -7}, ','));
}

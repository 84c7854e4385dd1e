// A pile driven by random measurements beside a list of them, and its rows beside rows made the long way round.

#include <zor_basis/timers.h>

#include "tests/support/random_steps.h"
#include "tests/timers/opened.h"
#include "tests/timers/report_model.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct Measurement {
    std::int64_t elapsed, suspended;
};

/// The statistics by going over the list.
std::array<std::int64_t, 8> statistics(std::vector<Measurement> const& list) {
    std::int64_t total = 0, max = 0, maxCount = 0, min = 0, minCount = 0, suspendTotal = 0, suspendMax = 0, ordinal = 0;
    for (Measurement const& m : list) {
        ++ordinal;
        total += m.elapsed;
        suspendTotal += m.suspended;
        suspendMax = std::max(suspendMax, m.suspended);
        if (m.elapsed > max) {
            max = m.elapsed;
            maxCount = ordinal;
        }
        if (min == 0 || m.elapsed < min) {
            min = m.elapsed;
            minCount = ordinal;
        }
    }
    return {ordinal, total, max, maxCount, min, minCount, suspendTotal, suspendMax};
}

std::string bytes(BufStr<255> const& line) { return {line.c_str(), line.size()}; }

class Separator {
public:
    explicit Separator(char now) { setThousandsSeparator(now); }
    ~Separator() { setThousandsSeparator(','); }
};

} // namespace

TEST(PileTimerModel, agrees_with_a_list_of_measurements) {
    auto random = randomSource();
    auto const below = [&random](std::uint64_t n) { return static_cast<std::int64_t>(random() % n); };
    std::vector<Measurement> list;
    std::string const name(static_cast<std::size_t>(below(170)), 'n');
    OpenedPile pile(name.c_str(), true);
    BufStr<255> line;
    std::int64_t const frequency = OpenedPile::frequency();
    for (std::uint64_t step = 0; step < randomSteps(20'000); ++step) {
        std::int64_t const what = below(100);
        if (what == 0) {
            pile.reset();
            list.clear();
        } else if (what < 80) {
            Measurement const m{below(std::uint64_t{1} << below(45)) - (what < 5 ? 20 : 0),
                                what < 40 ? below(std::uint64_t{1} << below(45)) : 0};
            list.push_back(m);
            pileUp(pile, m.elapsed, m.suspended);
        } else {
            auto const units = static_cast<int>(below(2'000'000) + 1);
            Separator const separator("\0,.'"[below(4)]);
            auto const convert = [frequency, units](std::int64_t ticks) {
                return ticks / frequency * units + ticks % frequency * units / frequency;
            };
            auto const [count, total, max, maxCount, min, minCount, suspendTotal, suspendMax] = statistics(list);
            pile.print(line, units);
            ASSERT_EQ(bytes(line),
                      modelRow(name,
                               {count, convert(total), count != 0 ? convert(total) / count : 0, convert(max), maxCount,
                                convert(min), convert(suspendTotal), convert(suspendMax)},
                               thousandsSeparator()));
        }
        ASSERT_EQ(pile.numbers(), statistics(list));
    }
}

TEST(PileTimerPrint, makes_a_row_of_any_line) {
    OpenedPile pile("stage", true);
    pileUp(pile, OpenedPile::frequency() * 3);
    std::string const expected = modelRow("stage", {1, 3, 3, 3, 1, 3, 0, 0}, ',');
    for (std::string const& before : {std::string(), std::string("x"), std::string(156, 'x'), std::string(1000, 'x')}) {
        BufStr<255> line(before);
        pile.print(line, 1);
        EXPECT_EQ(bytes(line), expected);
        pile.print(line, 1);
        EXPECT_EQ(bytes(line), expected);
    }
}

TEST(PileTimerPrint, has_no_numbers_but_0_where_nothing_was_measured) {
    BufStr<255> line;
    PileTimer("never", true).print(line, 1'000'000);
    EXPECT_EQ(bytes(line), "never" + std::string(43, ' ') + "0" + std::string(107, ' '));
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
    EXPECT_EQ(bytes(line), std::string(48, 'n') + "0" + std::string(101, 'n') + "      ");
    OpenedPile const longer(std::string(200, 'n').c_str(), true);
    longer.print(line, 1'000'000);
    EXPECT_EQ(bytes(line), std::string(48, 'n') + "0" + std::string(107, 'n')) << "no further than the row";
    pile.setId(3);
    pileUp(pile, OpenedPile::frequency() * 12'345);
    pile.print(line, 1);
    EXPECT_EQ(bytes(line).substr(40, 30), "nnnnnnnn1nnnnnnnnn12,345nnnnnn");
}

TEST(PileTimerPrint, averages_with_signs) {
    OpenedPile pile("stage", true);
    pileUp(pile, -OpenedPile::frequency() * 7);
    pileUp(pile, 0);
    BufStr<255> line;
    pile.print(line, 1);
    EXPECT_EQ(bytes(line), modelRow("stage", {2, -7, -3, 0, 0, -7, 0, 0}, ','));
}

TEST(ThousandsSeparator, is_a_comma_unless_set) {
    EXPECT_EQ(thousandsSeparator(), ',');
    OpenedPile pile("stage", true);
    pileUp(pile, OpenedPile::frequency() * 1'234'567);
    BufStr<255> line;
    for (char separator : {'.', ' ', '\0'}) {
        Separator const set(separator);
        EXPECT_EQ(thousandsSeparator(), separator);
        pile.print(line, 1);
        EXPECT_EQ(bytes(line), modelRow("stage", {1, 1'234'567, 1'234'567, 1'234'567, 1, 1'234'567, 0, 0}, separator));
    }
}

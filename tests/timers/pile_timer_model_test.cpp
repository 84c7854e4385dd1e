// Compares a pile with a list of its random measurements.

#include <zor_basis/timers.h>

#include "tests/support/operations.h"
#include "tests/support/random_steps.h"
#include "tests/timers/opened.h"
#include "tests/timers/report_model.h"
#include "tests/timers/separator.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct Measured {
    std::int64_t elapsed, suspended;
};

/// Computes the statistics from the list.
Statistics statistics(std::vector<Measured> const& list) {
    Statistics s;
    for (Measured const& m : list) {
        ++s.count;
        s.total += m.elapsed;
        s.suspendTotal += m.suspended;
        s.suspendMax = std::max(s.suspendMax, m.suspended);
        if (m.elapsed > s.max) {
            s.max = m.elapsed;
            s.maxCount = s.count;
        }
        if (s.min == 0 || m.elapsed < s.min) {
            s.min = m.elapsed;
            s.minCount = s.count;
        }
    }
    return s;
}

/// A pile, and the list of its measurements.
struct PileBesideList {
    std::int64_t below(std::uint64_t n) { return static_cast<std::int64_t>(random() % n); }
    /// A time of any magnitude up to 2 to the power of 44.
    std::int64_t ticks() { return below(std::uint64_t{1} << below(45)); }

    void measure(std::int64_t elapsed, std::int64_t suspended) {
        list.push_back({elapsed, suspended});
        pileUp(pile, elapsed, suspended);
    }

    std::mt19937_64 random = randomSource();
    std::string const name = std::string(static_cast<std::size_t>(below(170)), 'n');
    OpenedPile pile{name.c_str(), true};
    std::vector<Measured> list;
};

/// The numbers of the row for the statistics.
RowNumbers inUnits(Statistics const& s, int units) {
    auto const convert = [units](std::int64_t ticks) {
        std::int64_t const frequency = OpenedPile::frequency();
        return ticks / frequency * units + ticks % frequency * units / frequency;
    };
    std::int64_t const total = convert(s.total);
    return {.count = s.count,
            .total = total,
            .average = s.count != 0 ? total / s.count : 0,
            .max = convert(s.max),
            .maxCount = s.maxCount,
            .min = convert(s.min),
            .suspendTotal = convert(s.suspendTotal),
            .suspendMax = convert(s.suspendMax)};
}

void compareRows(PileBesideList& p) {
    auto const units = static_cast<int>(p.below(2'000'000) + 1);
    Separator const separator("\0,.'"[p.below(4)]);
    BufStr<255> line;
    p.pile.print(line, units);
    ASSERT_EQ(bytesOfRow(line), modelRow(p.name, inUnits(statistics(p.list), units), thousandsSeparator()));
}

constexpr Operation<PileBesideList> OPERATIONS[] = {
    {"reset", 1,
     [](PileBesideList& p) {
         p.pile.reset();
         p.list.clear();
     }},
    {"measure what may be negative, with a suspension", 4,
     [](PileBesideList& p) { p.measure(p.ticks() - 20, p.ticks()); }},
    {"measure with a suspension", 35, [](PileBesideList& p) { p.measure(p.ticks(), p.ticks()); }},
    {"measure", 40, [](PileBesideList& p) { p.measure(p.ticks(), 0); }},
    {"print", 20, compareRows},
};

} // namespace

TEST(PileTimerModel, agrees_with_a_list_of_measurements) {
    PileBesideList p;
    for (std::uint64_t step = 0; step < randomSteps(20'000); ++step) {
        Operation<PileBesideList> const& operation = drawn(OPERATIONS, p.random);
        operation.act(p);
        ASSERT_FALSE(testing::Test::HasFatalFailure()) << operation.name;
        ASSERT_EQ(p.pile.statistics(), statistics(p.list)) << operation.name << " at step " << step;
    }
}

#include "basis/timers/report_row.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr std::int64_t LOWEST = std::numeric_limits<std::int64_t>::min();
constexpr std::int64_t HIGHEST = std::numeric_limits<std::int64_t>::max();

} // namespace

namespace {

struct Placed {
    Row row;
    std::int64_t value;
    std::uint64_t end;
    char separator;
    bool terminating;
    std::string line; // "." is a place that was not touched
};

Placed const PLACED[] = {
    {{}, 0, 12, ',', false, "..........0"},
    {{}, 7, 12, ',', false, "..........7"},
    {{}, 999, 12, ',', false, "........999"},
    {{}, 1000, 12, ',', false, "......1,000"},
    {{}, 1234567, 12, ',', false, "..1,234,567"},
    {{}, 1234567, 12, '\0', false, "....1234567"},
    {{}, 1234567, 12, '\'', false, "..1'234'567"},
    {{}, -5, 12, ',', false, ".........-5"},
    {{}, -123, 12, ',', false, ".......-123"}, // no separator before the sign
    {{}, -1234, 12, ',', false, ".....-1,234"},
    {{}, 42, 12, ',', true, std::string(".........42") + '\0'},
    {{}, 12345678, 9, ',', false, ".345,678"}, // the first place is never reached
    {{}, 12345678, 9, '\0', false, ".2345678"},
    {{}, 1234, 5, ',', false, ".234"},
    {{}, 5, 2, ',', false, ""},
};

} // namespace

TEST(ReportRow, places_numbers_from_the_right) {
    for (Placed const& c : PLACED) {
        SCOPED_TRACE(c.row);
        std::string line(20, '.');
        ReportRow::placeNumber(line.data(), c.value, c.end, c.separator, c.terminating);
        EXPECT_EQ(line, c.line + std::string(20 - c.line.size(), '.'));
    }
}

TEST(ReportRow, places_the_extremes) {
    std::string line(40, '.');
    ReportRow::placeNumber(line.data(), LOWEST, 40, ',', false);
    EXPECT_EQ(line, std::string(13, '.') + "-9,223,372,036,854,775,808.");
    line.assign(40, '.');
    ReportRow::placeNumber(line.data(), HIGHEST, 40, '\0', false);
    EXPECT_EQ(line, std::string(20, '.') + "9223372036854775807.");
}

TEST(ReportRow, converts_ticks_cutting_off_fractions) {
    struct Case {
        Row row;
        std::int64_t ticks;
        int units;
        std::int64_t frequency, expected;
    };
    for (Case const& c : {
             Case{{}, 0, 1'000'000, 1'000'000'000, 0},
             Case{{}, 999, 1'000'000, 1'000'000'000, 0},
             Case{{}, 1000, 1'000'000, 1'000'000'000, 1},
             Case{{}, 1999, 1'000'000, 1'000'000'000, 1},
             Case{{}, -1999, 1'000'000, 1'000'000'000, -1}, // towards zero
             Case{{}, 123'456'789'012, 1'000'000, 10'000'000, 12'345'678'901},
             Case{{}, 10, 1'000'000, 3, 3'333'333},
             Case{{}, -10, 1'000'000, 3, -3'333'333},
             Case{{}, HIGHEST, 1'000'000, 1'000'000'000, 9'223'372'036'854'775}, // without overflow on the way
             Case{{}, LOWEST, 1'000'000, 1'000'000'000, -9'223'372'036'854'775},
             Case{{}, HIGHEST, 1'000'000'000, 1'000'000'000, HIGHEST},
             Case{{}, 5, -2, 1, -10},
             Case{{}, 5, 0, 1, 0},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(ReportRow::convert(c.ticks, c.units, c.frequency), c.expected);
    }
}

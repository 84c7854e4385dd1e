#include "tools/zbtool/timer_report.h"

#include "tests/zbtool/sample_reports.h"

#include <gtest/gtest.h>

using namespace zbtool;

namespace {

TEST(TimerReport, reads_what_the_library_writes) {
    TimerReport report;
    std::string reason;
    ASSERT_TRUE(readTimerReport(
        reportText(1'700'000'000, {rowText("render page", {12, 1'234'567, 102'880, 400'000, 7, -50, 1'000, 999}),
                                   rowText("never", {})}),
        report, reason))
        << reason;
    EXPECT_EQ(report.time, 1'700'000'000);
    ASSERT_EQ(report.rows.size(), 2u);
    EXPECT_EQ(report.rows[0], (TimerRow{"render page", 12, 1'234'567, 102'880, 400'000, 7, -50, 1'000, 999}));
    EXPECT_EQ(report.rows[1], TimerRow{"never"});
}

TEST(TimerReport, reads_numbers_that_are_wider_than_their_columns) {
    TimerReport report;
    std::string reason;
    TimerRow const wide{"w", 1'000, 999'999'999'999, 1, 2, 3, 4, 5, 6};
    ASSERT_TRUE(
        readTimerReport(reportText(1, {rowText("w", {1'000, 999'999'999'999, 1, 2, 3, 4, 5, 6})}), report, reason));
    EXPECT_EQ(report.rows.at(0), wide);
}

TEST(TimerReport, reads_every_separator_and_none) {
    for (char separator : {',', '.', '\'', '\0'}) {
        TimerReport report;
        std::string reason;
        ASSERT_TRUE(readTimerReport(
            reportText(1, {rowText("t", {1'234'567, 1'000'000, 999, 1'000, 0, 0, 12'345, 100}, separator)}), report,
            reason));
        EXPECT_EQ(report.rows.at(0), (TimerRow{"t", 1'234'567, 1'000'000, 999, 1'000, 0, 0, 12'345, 100}));
    }
}

TEST(TimerReport, reads_several_parts_of_one_second) {
    TimerReport report;
    std::string reason;
    std::string const text =
        reportText(5, {rowText("a", {1, 2, 3, 4, 5, 6, 7, 8})}) + reportText(5, {rowText("b", {})});
    ASSERT_TRUE(readTimerReport(text, report, reason)) << reason;
    EXPECT_EQ(report.rows.size(), 2u);
}

TEST(TimerReport, tells_which_line_does_not_belong) {
    std::string const good = reportText(5, {rowText("a", {1, 2, 3, 4, 5, 6, 7, 8})});
    std::string const empty = reportText(5, {});
    std::pair<std::string, int> const cases[] = {
        {"", 0},
        {"any text", 1},
        {good + "more\n", 5},
        {good.substr(good.find('\n') + 1), 1},
        {good.substr(0, good.size() - 60), 4},
        {"Log timestamp (sec): x\n", 1},
        {"Log timestamp (sec): 5\nother\n", 2},
        // Cut off in its heading, or before the end of a line.
        {empty.substr(0, 10), 1},
        {empty.substr(0, empty.find('\n') + 1), 2},
        {empty.substr(0, empty.find("Function") + 8), 3},
        {empty.substr(0, empty.find("Notes")), 3},
        {empty.substr(0, empty.find("Notes")) + "\n", 3},
        {empty.substr(0, empty.size() - 1), 3},
        {good.substr(0, good.size() - 1), 4},
    };
    for (auto const& [text, line] : cases) {
        SCOPED_TRACE(text);
        TimerReport report;
        std::string reason;
        EXPECT_FALSE(readTimerReport(text, report, reason));
        EXPECT_EQ(reason, "line " + std::to_string(line) + " does not belong to a timer report");
    }
}

TEST(TimerReport, merges_rows_of_one_name) {
    TimerReport const first{"1", 0, {{"a", 2, 100, 50, 80, 2, 20, 7, 5}, {"b"}}};
    TimerReport const second{
        "2", 0, {{"c", 1, 9, 9, 9, 1, 9, 0, 0}, {"b", 1, 4, 4, 4, 1, 4, 1, 1}, {"a", 1, 50, 50, 90, 1, 0, 8, 8}}};
    std::vector<TimerRow> const expected{
        {"a", 3, 150, 50, 90, 1, 20, 15, 8}, {"b", 1, 4, 4, 4, 1, 4, 1, 1}, {"c", 1, 9, 9, 9, 1, 9, 0, 0}};
    EXPECT_EQ(mergedRows({first, second}), expected);
    EXPECT_EQ(mergedRows({second, first}).at(2), expected[0]);
}

} // namespace

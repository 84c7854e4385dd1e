#include "tests/zbtool/sample_reports.h"
#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

/// "1.timer" and "2.timer": "slow" has become slower and "quick" quicker.
void makeReports(Tool const& tool) {
    put(tool / "1.timer",
        reportText(1'700'000'000, {rowText("quick <1>", {10, 1'000, 100, 200, 3, 50, 0, 0}),
                                   rowText("slow", {2, 8'000, 4'000, 5'000, 2, 3'000, 10, 10}), rowText("never", {})}));
    put(tool / "2.timer", reportText(1'700'003'600, {rowText("slow", {1, 6'000, 6'000, 6'000, 1, 6'000, 0, 0}),
                                                     rowText("quick <1>", {10, 500, 50, 90, 9, 40, 0, 0})}));
}

TEST(Timers, prints_one_report_by_total) {
    Tool tool;
    makeReports(tool);
    ToolResult const result = tool.run({"timers", "1.timer"});
    EXPECT_EQ(result.code, 0);
    EXPECT_EQ(result.output,
              "timer      count  total  average  maximum  maximum-count  minimum  suspended  suspended-maximum\n"
              "slow           2  8,000    4,000    5,000              2    3,000         10                 10\n"
              "quick <1>     10  1,000      100      200              3       50          0                  0\n"
              "never          0      0        0        0              0        0          0                  0\n");
}

TEST(Timers, merges_several_and_sorts_by_any_column) {
    Tool tool;
    makeReports(tool);
    EXPECT_EQ(tool.run({"timers", "--csv", "--sort", "count", "1.timer", "2.timer"}).output,
              "timer,count,total,average,maximum,maximum-count,minimum,suspended,suspended-maximum\n"
              "quick <1>,20,1500,75,200,3,40,0,0\nslow,3,14000,4666,6000,1,3000,10,10\nnever,0,0,0,0,0,0,0,0\n");
    EXPECT_EQ(tool.run({"timers", "--csv", "--sort", "timer", "--reverse", "1.timer"}).output.substr(84, 4), "slow");
    EXPECT_EQ(tool.run({"timers", "--json", "2.timer"}).output.substr(0, 40),
              "[\n  {\"timer\": \"slow\", \"count\": 1, \"total");
}

TEST(Timers, compares_the_averages_of_several) {
    Tool tool;
    makeReports(tool);
    EXPECT_EQ(tool.run({"timers", "--compare", "--csv", "1.timer", "2.timer"}).output,
              "timer,count-1,average-1,count-2,average-2,change-%\n"
              "slow,2,4000,1,6000,50\nnever,0,0,0,0,0\nquick <1>,10,100,10,50,-50\n");
}

TEST(Timers, writes_a_page_that_needs_nothing_else) {
    Tool tool;
    makeReports(tool);
    EXPECT_EQ(tool.run({"timers", "--html", "page.html", "1.timer", "2.timer"}), (ToolResult{0, "page.html\n", ""}));
    std::string const page = textOf(tool / "page.html");
    EXPECT_EQ(page.find("://"), std::string::npos);
    EXPECT_EQ(page.find("quick <1>"), std::string::npos);
    std::size_t const slow = page.find("<tr><td>slow</td>");
    std::size_t const quick = page.find("<tr><td>quick &lt;1&gt;</td>");
    EXPECT_LT(slow, quick);
    EXPECT_LT(quick, page.find("<tr><td>never</td>"));
    EXPECT_NE(page.find("<th class=\"number\" scope=\"col\" aria-sort=\"descending\">total</th>"), std::string::npos);
    EXPECT_NE(page.find("data-value=\"14000\">14,000<i style=\"width:100.0%\">"), std::string::npos);
    EXPECT_NE(page.find("data-value=\"1500\">1,500<i style=\"width:10.7%\">"), std::string::npos);
    EXPECT_NE(page.find("<p>1. 1.timer, 2023-11-14 22:13:20 UTC</p>"), std::string::npos);
    EXPECT_NE(page.find("prefers-color-scheme: dark"), std::string::npos);
    EXPECT_EQ(tool.content(), (Names{"1.timer", "2.timer", "page.html"}));
}

TEST(Timers, tells_what_is_missing_or_wrong) {
    Tool tool;
    makeReports(tool);
    put(tool / "text", "text\n");
    ToolResult const missing = tool.run({"timers", "1.timer", "gone.timer"});
    EXPECT_EQ(missing.code, 1);
    EXPECT_EQ(missing.output, "");
    EXPECT_TRUE(isOneLineAbout(missing.errors, "gone.timer"));
    ToolResult const other = tool.run({"timers", "text"});
    EXPECT_EQ(other.code, 1);
    EXPECT_EQ(other.errors, "zbtool: text: line 1 does not belong to a timer report\n");
    ToolResult const column = tool.run({"timers", "--sort", "bogus", "1.timer"});
    EXPECT_EQ(column.code, 2);
    EXPECT_TRUE(isOneLineAbout(column.errors, "bogus"));
    ToolResult const nowhere = tool.run({"timers", "--html", "no/such/page.html", "1.timer"});
    EXPECT_EQ(nowhere.code, 1);
    EXPECT_TRUE(isOneLineAbout(nowhere.errors, "no/such/page.html"));
    EXPECT_TRUE(isOneLineAbout(tool.run({"timers", "."}).errors, "."));
}

TEST(Timers, spare_existing_files_unless_told_to_overwrite) {
    Tool tool;
    makeReports(tool);
    put(tool / "page.html", "older");
    ToolResult const refused = tool.run({"timers", "--html", "page.html", "1.timer"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_EQ(refused.errors, "zbtool: page.html: exists already\n");
    EXPECT_EQ(textOf(tool / "page.html"), "older");
    EXPECT_EQ(tool.run({"timers", "--html", "page.html", "--overwrite", "1.timer"}).code, 0);
    EXPECT_NE(textOf(tool / "page.html").find("<table"), std::string::npos);
}

TEST(Timers, never_write_the_page_over_a_report) {
    Tool tool;
    makeReports(tool);
    std::string const report = textOf(tool / "2.timer");
    makeFolder(tool / "below");
    for (std::string const page : {"2.timer", "./2.timer", "below/../2.timer"}) {
        SCOPED_TRACE(page);
        ToolResult const refused = tool.run({"timers", "1.timer", "2.timer", "--overwrite", "--html", page});
        EXPECT_EQ(refused.code, 1);
        EXPECT_EQ(refused.errors, "zbtool: " + page + ": is one of the reports\n");
        EXPECT_TRUE(textOf(tool / "2.timer") == report);
    }
}

} // namespace

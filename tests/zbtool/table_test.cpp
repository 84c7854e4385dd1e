#include "tools/zbtool/table.h"

#include <gtest/gtest.h>

#include <limits>

using namespace zbtool;

namespace {

Table sample() {
    Table table;
    table.columns = {{"name"}, {"count", true, false}, {"total", true, true}};
    table.rows = {{std::string("b, \"x\""), std::int64_t{5}, std::int64_t{1'234'567}},
                  {std::string("a"), std::int64_t{50}, std::int64_t{0}},
                  {std::string("caf\xC3\xA9"), std::int64_t{5}, std::int64_t{-1'000}}};
    return table;
}

std::string namesOf(Table const& table) {
    std::string names;
    for (auto const& row : table.rows) names += row[0].text.substr(0, 1);
    return names;
}

TEST(Table, aligns_its_columns) {
    EXPECT_EQ(plainText(sample()), "name    count      total\n"
                                   "b, \"x\"      5  1,234,567\n"
                                   "a          50          0\n"
                                   "caf\xC3\xA9        5     -1,000\n");
}

TEST(Table, is_csv_with_quotes_where_necessary) {
    EXPECT_EQ(csvText(sample()), "name,count,total\r\n\"b, \"\"x\"\"\",5,1234567\r\na,50,0\r\ncaf\xC3\xA9,5,-1000\r\n");
}

TEST(Table, is_json_with_numbers_as_numbers) {
    EXPECT_EQ(jsonRows(sample()), "[\n  {\"name\": \"b, \\\"x\\\"\", \"count\": 5, \"total\": 1234567},\n"
                                  "  {\"name\": \"a\", \"count\": 50, \"total\": 0},\n"
                                  "  {\"name\": \"caf\xC3\xA9\", \"count\": 5, \"total\": -1000}\n]\n");
}

TEST(Table, sorts_numbers_from_the_largest_and_texts_from_the_first) {
    Table table = sample();
    EXPECT_TRUE(table.sort("total", false));
    EXPECT_EQ(namesOf(table), "bac");
    EXPECT_TRUE(table.sort("name", false));
    EXPECT_EQ(namesOf(table), "abc");
    EXPECT_TRUE(table.sort("name", true));
    EXPECT_EQ(namesOf(table), "cba");
    EXPECT_TRUE(table.sort("count", false));
    EXPECT_EQ(namesOf(table), "acb");
    EXPECT_TRUE(table.sort("count", true));
    EXPECT_EQ(namesOf(table), "cba");
    EXPECT_FALSE(table.sort("bogus", false));
}

TEST(Table, keeps_the_order_of_equal_rows) {
    Table table;
    table.columns = {{"place", true, false}, {"group", true, false}};
    constexpr std::int64_t ROWS = 100;
    for (std::int64_t i = 0; i < ROWS; ++i) table.rows.push_back({i, i % 2});
    EXPECT_TRUE(table.sort("group", false));
    for (std::size_t i = 1; i < table.rows.size(); ++i) {
        bool const isSameGroup = table.rows[i][1].number == table.rows[i - 1][1].number;
        EXPECT_TRUE(!isSameGroup || table.rows[i - 1][0].number < table.rows[i][0].number) << i;
    }
}

TEST(Table, groups_digits_by_three) {
    std::pair<std::int64_t, char const*> const cases[] = {
        {0, "0"},
        {999, "999"},
        {1'000, "1,000"},
        {-999, "-999"},
        {-1'000, "-1,000"},
        {123'456, "123,456"},
        {1'234'567, "1,234,567"},
        {std::numeric_limits<std::int64_t>::min(), "-9,223,372,036,854,775,808"}};
    for (auto const& [number, text] : cases) EXPECT_EQ(groupedDigits(number), text);
}

} // namespace

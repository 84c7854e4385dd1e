#include "tools/zbtool/json.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

using namespace zbtool;

namespace {

TEST(Json, writes_texts_that_every_reader_accepts) {
    struct Case {
        Row row;
        std::string_view text;
        char const* expected;
    };
    Case const cases[] = {
        {{}, "", "\"\""},
        {{}, "a\"b\\c/d", "\"a\\\"b\\\\c/d\""},
        {{}, {"\0\x1f\n\t\r", 5}, "\"\\u0000\\u001f\\n\\t\\r\""},
        {{}, "caf\xC3\xA9 \xF0\x9F\x98\x80", "\"caf\xC3\xA9 \xF0\x9F\x98\x80\""},
        {{}, "\xFF\xC3", "\"\xEF\xBF\xBD\xEF\xBF\xBD\""},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(jsonText(c.text), c.expected);
    }
}

TEST(Json, reads_objects_of_texts) {
    struct Case {
        Row row;
        char const* text;
        JsonMembers expected;
    };
    Case const cases[] = {
        {{}, "{}", {}},
        {{}, " { \"a\" : \"b\" ,\n\"c\":\"\"} \n", {{"a", "b"}, {"c", ""}}},
        {{}, R"({"\u0041\n\/": "\ud83d\ude00\u00e9"})", {{"A\n/", "\xF0\x9F\x98\x80\xC3\xA9"}}},
        {{}, R"({"nul": "\u0000"})", {{"nul", std::string(1, '\0')}}},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        JsonMembers members;
        std::string reason;
        EXPECT_TRUE(readJsonTexts(c.text, members, reason)) << reason;
        EXPECT_EQ(members, c.expected);
    }
}

TEST(Json, refuses_everything_else_and_tells_where) {
    for (char const* text :
         {"", "[]", "{", "{\"a\"}", "{\"a\":1}", "{\"a\":\"b\",}", "{\"a\":\"b\"} x", "{\"a\":\"b}", "{\"a\":\"\\x\"}",
          "{\"a\":\"\\u12\"}", "{\"a\":\"\\ud800\"}", "{\"a\":\"\\ud800\\u0041\"}", "{\"a\":\"\\ud800\\ue000\"}",
          "{\"a\":\"\\udc00\"}", "{\"a\":\"\n\"}", "{\"a\":\"\\"}) {
        SCOPED_TRACE(text);
        JsonMembers members;
        std::string reason;
        EXPECT_FALSE(readJsonTexts(text, members, reason));
        EXPECT_NE(reason.find("at byte"), std::string::npos);
    }
}

} // namespace

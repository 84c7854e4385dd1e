#include <zor_basis/flat.h>

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

TEST(FlatPaths, find_the_base_name) {
    struct Case {
        Row row;
        char const* text;
        int offset; // -1: null
    };
    for (Case const& c : {
             Case{{}, "a/b", 2},
             Case{{}, "a\\b", 2},
             Case{{}, "a/b\\c/d", 6},
             Case{{}, "a/", 2},
             Case{{}, "/", 1},
             Case{{}, "/a", 1},
             Case{{}, "a", -1},
             Case{{}, "", -1},
         }) {
        SCOPED_TRACE(c.row);
        char const* const found = ZB_baseNamePosition(c.text);
        EXPECT_EQ(found, c.offset < 0 ? nullptr : c.text + c.offset);
    }
    EXPECT_EQ(ZB_baseNamePosition(nullptr), nullptr);
}

TEST(FlatPaths, replace_backslashes) {
    char text[] = "\\a\\b/c\\";
    ZB_replaceBackSlashes(text);
    EXPECT_STREQ(text, "/a/b/c/");
    ZB_replaceBackSlashes(nullptr);

    char target[] = "xxxxxxxxxx";
    ZB_replaceBackSlashes2("\\a\\b", target);
    EXPECT_STREQ(target, "/a/b");
    EXPECT_EQ(target[5], 'x') << "nothing behind the terminator is written";
    char own[] = "a\\b";
    ZB_replaceBackSlashes2(own, own);
    EXPECT_STREQ(own, "a/b");
    ZB_replaceBackSlashes2("", target);
    EXPECT_STREQ(target, "");
}

TEST(FlatUri, resolves_escapes) {
    struct Case {
        Row row;
        char const* text;
        std::string expected; // terminator included
    };
    using namespace std::string_literals;
    for (Case const& c : {
             Case{{}, "a%20b", "a b\0"s},
             Case{{}, "%41%42", "AB\0"s},
             Case{{}, "%4a%4A", "JJ\0"s},
             Case{{}, "%zz", "\0\0"s},
             Case{{}, "%zzb", "\0b\0"s},
             Case{{}, "%g1", "\x01\0"s},
             Case{{}, "%1g", "\x10\0"s},
             Case{{}, "%ff", "\xFF\0"s},
             Case{{}, "a+b", "a+b\0"s},
             Case{{}, "%25%32", "%2\0"s}, // what comes out is not decoded again
             Case{{},
                  "%%412",
                  "\x04"
                  "12\0"s}, // "%" is no digit, and both characters behind a "%" are taken
             Case{{}, "", "\0"s},
         }) {
        SCOPED_TRACE(c.row);
        char out[32];
        std::memset(out, 'x', sizeof out);
        EXPECT_EQ(ZB_resolveURIEscapes(c.text, out), 0);
        EXPECT_EQ(std::string(out, c.expected.size()), c.expected);
        EXPECT_EQ(out[c.expected.size()], 'x') << "nothing behind the terminator is written";
        char own[32];
        std::strcpy(own, c.text);
        ZB_resolveURIEscapes(own, own);
        EXPECT_EQ(std::string(own, c.expected.size()), c.expected);
    }
}

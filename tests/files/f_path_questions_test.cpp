#include "tests/files/path_kinds.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

template <class Kind>
class FPathQuestions : public PathOfKind<Kind> {};
TYPED_TEST_SUITE(FPathQuestions, PathKinds);

} // namespace

TYPED_TEST(FPathQuestions, knows_what_kind_it_is) {
    struct Case {
        Row row;
        char const* path;
        bool absolute, dos, url, wildcard;
    };
    for (Case const& c : {
             Case{{}, "", false, false, false, false},          Case{{}, "a", false, false, false, false},
             Case{{}, "/", true, false, false, false},          Case{{}, "\\a", true, false, false, false},
             Case{{}, "C:\\", true, true, false, false},        Case{{}, "C:/x", true, true, false, false},
             Case{{}, "C:", false, false, false, false},        Case{{}, "C:x", false, false, false, false},
             Case{{}, "1:/", true, true, false, false},         Case{{}, "/:/", true, true, false, false},
             Case{{}, ":/", false, false, false, false},        Case{{}, "C://dir", true, true, true, false},
             Case{{}, "a://", true, true, false, false},        Case{{}, "file://y", false, false, true, false},
             Case{{}, "file:\\\\y", false, false, true, false}, Case{{}, "file:/\\y", false, false, true, false},
             Case{{}, "file://", false, false, false, false},   Case{{}, "file:/", false, false, false, false},
             Case{{}, "a:b://c", false, false, false, false}, // only the first ":" counts
             Case{{}, "://x", false, false, true, false},       Case{{}, "a*", false, false, false, true},
             Case{{}, "a?b", false, false, false, true},        Case{{}, "/*", true, false, false, true},
         }) {
        SCOPED_TRACE(c.row);
        auto const path = this->p(c.path);
        auto const text = this->t(c.path);
        using Path = typename TypeParam::Path;
        EXPECT_EQ(path.isAbsolute(), c.absolute);
        EXPECT_EQ(Path::isAbsolute(text.c_str()), c.absolute);
        EXPECT_EQ(path.isDos(), c.dos);
        EXPECT_EQ(Path::isDos(text.c_str()), c.dos);
        EXPECT_EQ(path.isURL(), c.url);
        EXPECT_EQ(Path::isURL(text.c_str()), c.url);
        EXPECT_EQ(path.isWildCard(), c.wildcard);
        EXPECT_EQ(Path::isWildCard(text.c_str()), c.wildcard);
    }
    using Path = typename TypeParam::Path;
    EXPECT_FALSE(Path::isAbsolute(nullptr) || Path::isDos(nullptr) || Path::isURL(nullptr) ||
                 Path::isWildCard(nullptr) || Path::isFake(nullptr));
}

TYPED_TEST(FPathQuestions, knows_its_slashes) {
    using Path = typename TypeParam::Path;
    using Char = typename TypeParam::Char;
    auto const path = this->p("/a\\");
    EXPECT_TRUE(path.isSlash(0) && !path.isSlash(1) && path.isSlash(2u));
    EXPECT_FALSE(path.isSlash(3) || path.isSlash(1000ull));
    EXPECT_TRUE(Path::isSlash(Char('/')) && Path::isSlash(Char('\\')));
    EXPECT_FALSE(Path::isSlash(Char('a')) || Path::isSlash(Char()));
    EXPECT_EQ(Path::slashGood, Char('\\'));
    EXPECT_EQ(Path::slashBad, Char('/'));
}

TYPED_TEST(FPathQuestions, lies_in_a_folder_or_not) {
    struct Case {
        Row row;
        char const *path, *folder;
        bool expected;
    };
    for (Case const& c : {
             Case{{}, "/a/b", "/a/b", true},  Case{{}, "/a/b/c", "/a/b", true},  Case{{}, "/a/bc", "/a/b", false},
             Case{{}, "/a", "/a/b", false},   Case{{}, "/A/b/c", "/a/B", true},  Case{{}, "\\a\\b", "/a", true},
             Case{{}, "/a//b", "/a/b", true}, Case{{}, "/a/b", "//a/\\b", true}, Case{{}, "/a", "/a/", true},
             Case{{}, "/a", "/a//", true},    Case{{}, "/a/", "/a", true},       Case{{}, "/a/x", "/a/", true},
             Case{{}, "/a", "/a/x", false},   Case{{}, "a", "/a", false},        Case{{}, "/a", "a", false},
             Case{{}, "/a/", "/a/b", false},  Case{{}, "a", "", true},           Case{{}, "", "", true},
             Case{{}, "", "a", false},        Case{{}, "", "/", false},          Case{{}, "/x", "/", true},
             Case{{}, "ab", "a", false},
         }) {
        SCOPED_TRACE(c.row);
        auto const path = this->t(c.path);
        auto const folder = this->t(c.folder);
        EXPECT_EQ(TypeParam::Path::isSub(path.c_str(), folder.c_str()), c.expected);
        EXPECT_EQ(this->p(c.folder).isSub(path.c_str()), c.expected) << "the member asks for what lies in it";
    }
    auto const text = this->t("a");
    EXPECT_TRUE(TypeParam::Path::isSub(text.c_str(), nullptr));
    EXPECT_TRUE(TypeParam::Path::isSub(nullptr, nullptr));
    EXPECT_FALSE(TypeParam::Path::isSub(nullptr, text.c_str()));
}

TYPED_TEST(FPathQuestions, is_split_at_its_last_slash) {
    struct Case {
        Row row;
        char const* path;
        std::uint64_t len;
        char const *directory, *name;
        std::uint64_t offset;
    };
    for (Case const& c : {
             Case{{}, "a/b/c", 0, "a/b", "c", 4}, Case{{}, "a\\b", 0, "a", "b", 2},
             Case{{}, "a/b\\c", 0, "a/b", "c", 4}, Case{{}, "abc", 0, "", "abc", 0}, Case{{}, "", 0, "", "", 0},
             Case{{}, "a/b/", 0, "a/b", "", 4}, Case{{}, "a//b", 0, "a/", "b", 3},
             Case{{}, "/abc", 0, "/abc", "abc", 1}, Case{{}, "/", 0, "/", "", 1}, Case{{}, "//x", 0, "/", "x", 2},
             Case{{}, "a/b/c", 3, "a", "b", 2}, Case{{}, "a/b/c", 2, "a", "", 2}, Case{{}, "a/b/c", 1, "", "a", 0},
             Case{{}, "/abc/d", 4, "/abc/d", "abc", 1}, // the whole text up to its end
         }) {
        SCOPED_TRACE(c.row);
        auto const text = this->t(c.path);
        auto directory = this->p("old");
        auto name = this->p("old");
        TypeParam::Path::split(text.c_str(), directory, name, c.len);
        EXPECT_EQ(this->plain(directory), c.directory);
        EXPECT_EQ(this->plain(name), c.name);
        EXPECT_EQ(TypeParam::Path::offsetName(text.c_str(), c.len), c.offset);
        if (c.len == 0) {
            auto const path = this->p(c.path);
            path.split(directory, name);
            EXPECT_EQ(this->plain(directory), c.directory);
            EXPECT_EQ(this->plain(name), c.name);
            EXPECT_EQ(path.offsetName(), c.offset);
        }
    }
    auto directory = this->p("old");
    auto name = this->p("old");
    TypeParam::Path::split(nullptr, directory, name);
    EXPECT_EQ(this->plain(directory) + this->plain(name), "");
    EXPECT_EQ(TypeParam::Path::offsetName(nullptr), 0u);
}

TEST(FPathSplit, Kept_path_05_keeps_the_whole_text_when_the_only_slash_is_first) {
    FPath directory;
    FPath name;
    FPath("/abc").split(directory, name);
    EXPECT_STREQ(directory, "/abc");
    EXPECT_STREQ(name, "abc");
}

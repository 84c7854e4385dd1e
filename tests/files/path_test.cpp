// One set of tables for narrow and wide paths. Where the two differ a table has a column for each.

#include <zor_basis/files/f_path.h>
#include <zor_basis/files/wc_path.h>

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

struct Narrow {
    using Path = FPath;
    using View = Str;
    using Char = char;
    using Text = std::string;
    static constexpr bool isWide = false;
    static Char const* text(Path const& path) { return path.c_str(); }
};

struct Wide {
    using Path = WcPath;
    using View = WStr;
    using Char = WChar;
    using Text = std::basic_string<WChar>;
    static constexpr bool isWide = true;
    static Char const* text(Path const& path) { return path.wstr(); }
};

template <class Kind>
class PathTest : public testing::Test {
public:
    /// The tables are ASCII.
    static typename Kind::Text t(std::string const& text) { return {text.begin(), text.end()}; }
    static typename Kind::Path p(std::string const& text) {
        auto const own = t(text);
        return typename Kind::View(own);
    }
    static std::string plain(typename Kind::Path const& path) {
        std::string text;
        for (std::uint64_t i = 0; i < path.size(); ++i) text.push_back(static_cast<char>(Kind::text(path)[i]));
        EXPECT_EQ(Kind::text(path)[path.size()], 0) << "terminated";
        return text;
    }
};

using Kinds = testing::Types<Narrow, Wide>;
TYPED_TEST_SUITE(PathTest, Kinds);

} // namespace

TYPED_TEST(PathTest, breathes) {
    typename TypeParam::Path path;
    EXPECT_TRUE(path.empty());
    path.add(this->t("job").c_str()).add(this->t("page.tif").c_str());
    EXPECT_EQ(this->plain(path), "job/page.tif");
}

TYPED_TEST(PathTest, is_made_from_every_kind_of_source) {
    using Path = typename TypeParam::Path;
    using View = typename TypeParam::View;
    using Char = typename TypeParam::Char;
    auto const text = this->t("a/b\\c");
    auto const more = this->t("x");
    EXPECT_EQ(this->plain(Path(text.c_str())), "a/b\\c") << "nothing is normalised";
    EXPECT_EQ(this->plain(Path(text.c_str(), 3)), "a/b");
    EXPECT_EQ(this->plain(Path(text.c_str(), 3u)), "a/b");
    EXPECT_EQ(this->plain(Path(text.c_str(), 0)), "a/b\\c") << "a length of 0 is measured";
    EXPECT_EQ(this->plain(Path(static_cast<Char const*>(nullptr))), "");
    EXPECT_EQ(this->plain(Path(static_cast<Char const*>(nullptr), 7)), "");
    EXPECT_EQ(this->plain(Path(View(text))), "a/b\\c");
    EXPECT_EQ(this->plain(Path(View(text), View(more))), "a/b\\c/x");
    EXPECT_EQ(this->plain(Path(View(text), more.c_str())), "a/b\\c/x");
    EXPECT_EQ(this->plain(Path(text.c_str(), more.c_str())), "a/b\\c/x");
    EXPECT_EQ(this->plain(Path(text.c_str(), View(more))), "a/b\\c/x");
    EXPECT_EQ(this->plain(Path(text.c_str(), static_cast<Char const*>(nullptr))), "a/b\\c");
    Path path(text.c_str());
    Path const copy(path);
    EXPECT_EQ(this->plain(copy), "a/b\\c");
    path = more.c_str();
    EXPECT_EQ(this->plain(path), "x");
    path = View(text);
    EXPECT_EQ(this->plain(path), "a/b\\c");
    path = static_cast<Char const*>(nullptr);
    EXPECT_EQ(this->plain(path), "");
    path = copy;
    EXPECT_EQ(this->plain(path), "a/b\\c");
    path += more.c_str();
    path += View(more);
    EXPECT_EQ(this->plain(path), "a/b\\c/x/x");
    path.assign(View(more), View(text));
    EXPECT_EQ(this->plain(path), "x/a/b\\c");
    path.assign(View(more), text.c_str());
    EXPECT_EQ(this->plain(path), "x/a/b\\c");
}

TYPED_TEST(PathTest, joins_with_a_forward_slash) {
    struct Case {
        Row row;
        char const *path, *component, *narrow, *wide;
    };
    for (Case const& c : {
             Case{{}, "dir", "x", "dir/x", "dir/x"},
             Case{{}, "dir/", "x", "dir/x", "dir/x"},
             Case{{}, "", "x", "x", "x"},
             Case{{}, "", "/x", "/x", "/x"},
             Case{{}, "dir", "", "dir", "dir"},
             Case{{}, "dir\\", "", "dir\\", "dir\\"},
             Case{{}, "a/", "/b", "a//b", "a//b"},
             Case{{}, "a", "/b", "a//b", "a//b"},
             Case{{}, "/", "x", "/x", "/x"},
             Case{{}, "dir\\", "x", "dir\\/x", "dir\\x"}, // the difference
             Case{{}, "\\", "x", "\\/x", "\\x"},
         }) {
        SCOPED_TRACE(c.row);
        auto path = this->p(c.path);
        EXPECT_EQ(&path.add(this->t(c.component).c_str()), &path);
        EXPECT_EQ(this->plain(path), TypeParam::isWide ? c.wide : c.narrow);
    }
    auto path = this->p("dir");
    path.add(nullptr).add(nullptr, 5).add(this->t("component").c_str(), 4);
    EXPECT_EQ(this->plain(path), "dir/comp");
}

TEST(FPathJoin, Kept_path_01_only_a_forward_slash_is_an_end) { EXPECT_STREQ(FPath("dir\\").add("x"), "dir\\/x"); }

TEST(WcPathJoin, Kept_path_07_a_slash_of_either_kind_is_an_end) {
    EXPECT_TRUE(WcPath(ZB_W("dir\\")).add(ZB_W("x")) == ZB_W("dir\\x"));
    EXPECT_TRUE(WcPath(ZB_W("dir/")).add(ZB_W("x")) == ZB_W("dir/x"));
}

TYPED_TEST(PathTest, joins_in_one_block_of_exactly_the_new_length) {
    std::string const folder(200, 'd');
    std::string const name(100, 'n');
    auto path = this->p(folder);
    path.add(this->t(name).c_str());
    EXPECT_EQ(this->plain(path), folder + "/" + name);
    EXPECT_EQ(path.sizeBuf(), 301u);
    auto full = this->p(std::string(250, 'd')); // fills the inline area to its last character
    full.add(this->t("1234").c_str());
    EXPECT_EQ(full.size(), 255u);
    EXPECT_EQ(full.sizeBuf(), 255u);
    full.add(this->t("5").c_str());
    EXPECT_EQ(full.sizeBuf(), 257u);
}

TYPED_TEST(PathTest, joins_parts_of_itself) {
    for (std::size_t length : {5u, 120u, 130u, 250u, 300u}) {
        std::string const text = std::string(length, 'a') + "tail";
        auto path = this->p(text);
        path.add(TypeParam::text(path) + length);
        EXPECT_EQ(this->plain(path), text + "/tail");
        path = this->p(text);
        path.add(path);
        EXPECT_EQ(this->plain(path), text + "/" + text);
        path = this->p(text);
        path.assign(path, path);
        EXPECT_EQ(this->plain(path), text + "/" + text);
        path = this->p(text);
        path.assign(typename TypeParam::View(TypeParam::text(path) + length), path);
        EXPECT_EQ(this->plain(path), "tail/" + text);
    }
}

TYPED_TEST(PathTest, appends_extensions) {
    struct Case {
        Row row;
        char const *path, *extension;
        bool addDot;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, "a", "tif", true, "a.tif"},
             Case{{}, "a", "tif", false, "atif"},
             Case{{}, "a.", "tif", true, "a.tif"},
             Case{{}, "a", ".tif", true, "a.tif"},
             Case{{}, "a.", ".tif", true, "a..tif"},
             Case{{}, "a", "", true, "a."},
             Case{{}, "a.", "", true, "a."},
             Case{{}, "a", "", false, "a"},
             Case{{}, "", "tif", true, ".tif"},
             Case{{}, "", "", true, "."},
         }) {
        SCOPED_TRACE(c.row);
        auto path = this->p(c.path);
        auto const extension = this->t(c.extension);
        path.addExt(typename TypeParam::View(extension), c.addDot);
        EXPECT_EQ(this->plain(path), c.expected);
    }
    auto path = this->p(std::string(254, 'a'));
    path.addExt(path, true);
    EXPECT_EQ(this->plain(path), std::string(254, 'a') + "." + std::string(254, 'a'));
}

TYPED_TEST(PathTest, ends_in_a_slash_or_not) {
    struct Case {
        Row row;
        char const *path, *with, *without;
    };
    for (Case const& c : {
             Case{{}, "a", "a\\", "a"},
             Case{{}, "a/", "a/", "a"},
             Case{{}, "a\\", "a\\", "a"},
             Case{{}, "a//", "a//", "a/"},
             Case{{}, "a/\\", "a/\\", "a/"},
             Case{{}, "/", "/", ""},
             Case{{}, "", "\\", ""},
         }) {
        SCOPED_TRACE(c.row);
        auto path = this->p(c.path);
        EXPECT_EQ(this->plain(path.assureTermSlash()), c.with);
        path = this->p(c.path);
        EXPECT_EQ(this->plain(path.remTermSlash()), c.without);
    }
}

TEST(FPathSlash, Kept_path_02_an_empty_path_becomes_a_backslash) { EXPECT_STREQ(FPath().assureTermSlash(), "\\"); }

TYPED_TEST(PathTest, replaces_slashes) {
    auto path = this->p("\\a/b\\\\c/");
    EXPECT_EQ(this->plain(path.replaceBackSlashes()), "/a/b//c/");
    EXPECT_EQ(this->plain(path.replaceSlashes()), "\\a\\b\\\\c\\");
    auto text = this->t("a\\b/c");
    TypeParam::Path::replaceBackSlashes(text.data());
    EXPECT_EQ(text, this->t("a/b/c"));
    TypeParam::Path::replaceSlashes(text.data());
    EXPECT_EQ(text, this->t("a\\b\\c"));
    TypeParam::Path::replaceSlashes(nullptr);
    TypeParam::Path::replaceBackSlashes(nullptr);
}

TYPED_TEST(PathTest, is_normalised) {
    struct Case {
        Row row;
        char const* source;
        bool url;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, "\\\\srv\\\\share\\a", false, "//srv/share/a"},
             Case{{}, "a\\\\b", false, "a/b"},
             Case{{}, "a/\\/b\\", false, "a/b/"},
             Case{{}, "/a", false, "/a"},
             Case{{}, "//a", false, "//a"},
             Case{{}, "///a//b", false, "//a/b"},
             Case{{}, "/\\a", false, "//a"},
             Case{{}, "", false, ""},
             Case{{}, "/", false, "/"},
             Case{{}, "//", false, "//"},
             Case{{}, "a//", false, "a/"},
             Case{{}, "file:/x", true, "file://x"},
             Case{{}, "file:\\\\\\srv", true, "file://srv"},
             Case{{}, "file://srv//a", true, "file://srv/a"},
             Case{{}, "/a", true, "//a"},
             Case{{}, "a", true, "a"},
             Case{{}, "", true, ""},
             Case{{}, "a/", true, "a//"},
             Case{{}, "a/b//c", true, "a//b/c"},
         }) {
        SCOPED_TRACE(c.row);
        auto path = this->p("old");
        EXPECT_EQ(&path.normalize(this->t(c.source).c_str(), c.url), &path);
        EXPECT_EQ(this->plain(path), c.expected);
        path = this->p(c.source);
        EXPECT_EQ(this->plain(path.normalize(TypeParam::text(path), c.url)), c.expected) << "its own text";
    }
    auto path = this->p("old");
    EXPECT_EQ(this->plain(path.normalize(nullptr, false)), "");
}

TEST(FPathNormalize, Kept_path_03_the_first_slash_of_a_url_is_doubled_wherever_it_stands) {
    EXPECT_STREQ(FPath().normalize("a/", true), "a//");
}

TYPED_TEST(PathTest, grows_to_the_source_and_two_when_it_is_normalised) {
    typename TypeParam::Path path;
    path.normalize(this->t(std::string(253, 'a')).c_str(), false);
    EXPECT_EQ(path.sizeBuf(), 255u);
    path.normalize(this->t(std::string(254, 'a')).c_str(), false);
    EXPECT_EQ(path.sizeBuf(), 256u);
    path.normalize(this->t(std::string(1000, '/')).c_str(), false);
    EXPECT_EQ(path.sizeBuf(), 1002u);
    EXPECT_EQ(this->plain(path), "//");
}

TYPED_TEST(PathTest, knows_what_kind_it_is) {
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

TYPED_TEST(PathTest, knows_its_slashes) {
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

TYPED_TEST(PathTest, lies_in_a_folder_or_not) {
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

TYPED_TEST(PathTest, is_split_at_its_last_slash) {
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

TYPED_TEST(PathTest, matches_wildcards) {
    struct Case {
        Row row;
        char const *pattern, *name;
        bool expected;
    };
    for (Case const& c : {
             Case{{}, "*.txt", "a.txt", true},
             Case{{}, "*.txt", "A.TXT", false},
             Case{{}, "*", "anything/at\\all", true},
             Case{{}, "*", "", true},
             Case{{}, "", "", true},
             Case{{}, "", "a", false},
             Case{{}, "a?c", "a/c", true},
             Case{{}, "a//b", "a\\b", true},
             Case{{}, "**", "a", true},
             Case{{}, "a*b*c", "aXbYc", true},
             Case{{}, "a*b", "a", false},
         }) {
        SCOPED_TRACE(c.row);
        auto const pattern = this->t(c.pattern);
        auto const name = this->t(c.name);
        EXPECT_EQ(TypeParam::Path::matchWildCard(pattern.c_str(), name.c_str()), c.expected);
        EXPECT_EQ(this->p(c.name).matchWildCard(pattern.c_str()), c.expected);
    }
    EXPECT_TRUE(TypeParam::Path::matchWildCard(nullptr, nullptr));
}

TEST(FPathWildCard, Kept_path_06_a_star_before_more_pattern_needs_some_name_and_may_be_an_equal_character) {
    EXPECT_FALSE(FPath::matchWildCard("a*?", "a"));
    EXPECT_FALSE(FPath::matchWildCard("*", "*a"));
    EXPECT_TRUE(FPath::matchWildCard("*a", "*a"));
}

// ---- URLs ----------------------------------------------------------------------------------------------------------

TYPED_TEST(PathTest, becomes_the_network_path_of_a_file_url) {
    struct Case {
        Row row;
        char const* url;
        char const* expected; // null: refused
    };
    for (Case const& c : {
             Case{{}, "file://srv/share/a%20b.txt", "//srv/share/a b.txt"},
             Case{{}, "FILE://srv/a", "//srv/a"},
             Case{{}, "FiLe://srv/a", "//srv/a"},
             Case{{}, "file://u:p@srv/a", "//srv/a"},
             Case{{}, "file://a@b@srv", "//srv"},
             Case{{}, "file:///x", "///x"},
             Case{{}, "file://u@", "//"},
             Case{{}, "file://%41bc", "//%41bcAbc"},
             Case{{}, "file://", nullptr},
             Case{{}, "http://srv/a", nullptr},
             Case{{}, "afile://srv/a", nullptr},
             Case{{}, "files://srv/a", nullptr},
             Case{{}, "file:/srv/a", nullptr},
             Case{{}, "", nullptr},
         }) {
        SCOPED_TRACE(c.row);
        auto const url = this->t(c.url);
        for (bool asView : {false, true}) {
            auto path = this->p("old");
            bool const done = asView ? path.ConvertFileURLtoUNC(typename TypeParam::View(url))
                                     : path.ConvertFileURLtoUNC(url.c_str());
            EXPECT_EQ(done, c.expected != nullptr);
            EXPECT_EQ(this->plain(path), c.expected != nullptr ? c.expected : "old");
        }
        auto own = this->p(c.url);
        EXPECT_EQ(own.ConvertFileURLtoUNC(own), c.expected != nullptr);
        EXPECT_EQ(this->plain(own), c.expected != nullptr ? c.expected : c.url);
    }
    auto path = this->p("old");
    EXPECT_FALSE(path.ConvertFileURLtoUNC(static_cast<typename TypeParam::Char const*>(nullptr)));
}

TEST(FPathUrl, decodes_percent_escapes) {
    struct Case {
        Row row;
        char const *text, *expected;
    };
    for (Case const& c : {
             Case{{}, "a%20b", "a b"},
             Case{{}, "a%2Fb%2fc", "a/b/c"},
             Case{{}, "a%4", "a%4"},
             Case{{}, "a%", "a%"},
             Case{{}, "a%zz", "a%zz"},
             Case{{}, "a%%41", "a%A"},
             Case{{}, "a+b", "a+b"},
             Case{{}, "a%00b", "ab"},
             Case{{}, "", ""},
             Case{{}, "abc", "abc"},
             Case{{}, "%41", "%41A"},
             Case{{}, "%41b", "%41bAb"},
             Case{{}, "a%41%42c", "aA%42cBc"},
         }) {
        SCOPED_TRACE(c.row);
        FPath path("x");
        EXPECT_EQ(&path.addDecodedUrl(c.text), &path);
        EXPECT_EQ(std::string(path), std::string("x") + c.expected);
    }
}

TEST(FPathUrl, Kept_path_04_an_escape_without_a_literal_before_it_brings_all_that_follows) {
    FPath path;
    path.addDecodedUrl("%41");
    EXPECT_STREQ(path, "%41A");
}

TEST(FPathUrl, never_reads_past_the_view) {
    FPath path;
    path.addDecodedUrl(Str("%41%42 and more", 3));
    EXPECT_STREQ(path, "%41A");
    path.clear();
    path.addDecodedUrl(Str("a%41", 3));
    EXPECT_STREQ(path, "a%4");
    FPath own("%41bc");
    own.addDecodedUrl(own);
    EXPECT_STREQ(own, "%41bc%41bcAbc");
}

TEST(FPathUrl, is_taken_apart) {
    struct Case {
        Row row;
        char const *url, *scheme, *path, *user, *password; // null: not touched
    };
    for (Case const& c : {
             Case{{}, "http://host/a", "http", "host/a", nullptr, nullptr},
             Case{{}, "http://u:p@host/a", "http", "host/a", "u", "p"},
             Case{{}, "http://u@host/a", "http", "host/a", "u", nullptr},
             Case{{}, "http://u:p:q@host", "http", "host", "u", "p:q"},
             Case{{}, "http://u:p@q@host", "http", "host", "u", "p@q"},
             Case{{}, "http://@host", "http", "host", "", nullptr},
             Case{{}, "http://:@host", "http", "host", "", ""},
             Case{{}, "http://u@host:80/", "http", "host:80/", "u", nullptr}, // the ":" is behind the "@"
             Case{{}, "http://", "http", "", nullptr, nullptr},
             Case{{}, "://x", "", "x", nullptr, nullptr},
             Case{{}, "a@b://x", "a@b", "x", nullptr, nullptr},
             Case{{}, "http:/host", nullptr, nullptr, nullptr, nullptr},
             Case{{}, "", nullptr, nullptr, nullptr, nullptr},
         }) {
        SCOPED_TRACE(c.row);
        BufStr<255> scheme("old");
        BufStr<255> user("old");
        BufStr<255> password("old");
        FPath path("old");
        EXPECT_EQ(FPath::ParseUrl(c.url, &scheme, &path, &user, &password), c.scheme != nullptr);
        EXPECT_STREQ(scheme, c.scheme != nullptr ? c.scheme : "old");
        EXPECT_STREQ(path, c.path != nullptr ? c.path : "old");
        EXPECT_STREQ(user, c.user != nullptr ? c.user : "old");
        EXPECT_STREQ(password, c.password != nullptr ? c.password : "old");
        EXPECT_EQ(FPath::ParseUrl(c.url, nullptr, nullptr, nullptr, nullptr), c.scheme != nullptr);
    }
    FPath path;
    EXPECT_TRUE(FPath::ParseUrl(Str("http://host/and/more", 11), nullptr, &path, nullptr, nullptr));
    EXPECT_STREQ(path, "host");
}

// ---- against a plain reading ---------------------------------------------------------------------------------------

TYPED_TEST(PathTest, survives_random_changes_beside_a_plain_text) {
    std::mt19937_64 random = randomSource();
    typename TypeParam::Path path;
    std::string model;
    for (std::uint64_t step = randomSteps(50'000); step > 0; --step) {
        std::string piece;
        for (std::uint64_t n = random() % 12; n > 0; --n) piece.push_back("ab./\\%4"[random() % 7]);
        switch (random() % 6) {
        case 0:
            path.add(this->t(piece).c_str());
            if (!piece.empty()) {
                bool const ended =
                    !model.empty() && (model.back() == '/' || (TypeParam::isWide && model.back() == '\\'));
                model += (model.empty() || ended ? "" : "/") + piece;
            }
            break;
        case 1:
            path.assureTermSlash();
            if (model.empty() || (model.back() != '/' && model.back() != '\\')) model += '\\';
            break;
        case 2:
            path.remTermSlash();
            if (!model.empty() && (model.back() == '/' || model.back() == '\\')) model.pop_back();
            break;
        case 3:
            path.replaceBackSlashes();
            for (char& c : model) c = c == '\\' ? '/' : c;
            break;
        case 4: {
            auto const extension = this->t(piece);
            path.addExt(typename TypeParam::View(extension), true);
            if ((model.empty() || model.back() != '.') && (piece.empty() || piece[0] != '.')) model += '.';
            model += piece;
            break;
        }
        default:
            if (model.size() > 600 || random() % 50 == 0) {
                path.clear();
                model.clear();
            }
        }
        ASSERT_EQ(this->plain(path), model);
    }
}

#include "tests/files/path_kinds.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

template <class Kind>
class FPathOfEitherWidth : public PathOfKind<Kind> {};
TYPED_TEST_SUITE(FPathOfEitherWidth, PathKinds);

} // namespace

TYPED_TEST(FPathOfEitherWidth, breathes) {
    typename TypeParam::Path path;
    EXPECT_TRUE(path.empty());
    path.add(this->t("job").c_str()).add(this->t("page.tif").c_str());
    EXPECT_EQ(this->plain(path), "job/page.tif");
}

TYPED_TEST(FPathOfEitherWidth, is_made_from_every_kind_of_source) {
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

TYPED_TEST(FPathOfEitherWidth, joins_with_a_forward_slash) {
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
        EXPECT_EQ(this->plain(path), TypeParam::IS_WIDE ? c.wide : c.narrow);
    }
    auto path = this->p("dir");
    path.add(nullptr).add(nullptr, 5).add(this->t("component").c_str(), 4);
    EXPECT_EQ(this->plain(path), "dir/comp");
}

TEST(FPathJoin, Kept_path_01_only_a_forward_slash_is_an_end) { EXPECT_STREQ(FPath("dir\\").add("x"), "dir\\/x"); }

TYPED_TEST(FPathOfEitherWidth, joins_in_one_block_of_exactly_the_new_length) {
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

TYPED_TEST(FPathOfEitherWidth, joins_parts_of_itself) {
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

TYPED_TEST(FPathOfEitherWidth, appends_extensions) {
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

TYPED_TEST(FPathOfEitherWidth, ends_in_a_slash_or_not) {
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

TYPED_TEST(FPathOfEitherWidth, replaces_slashes) {
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

TYPED_TEST(FPathOfEitherWidth, is_normalised) {
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

TYPED_TEST(FPathOfEitherWidth, grows_to_the_source_and_two_when_it_is_normalised) {
    typename TypeParam::Path path;
    path.normalize(this->t(std::string(253, 'a')).c_str(), false);
    EXPECT_EQ(path.sizeBuf(), 255u);
    path.normalize(this->t(std::string(254, 'a')).c_str(), false);
    EXPECT_EQ(path.sizeBuf(), 256u);
    path.normalize(this->t(std::string(1000, '/')).c_str(), false);
    EXPECT_EQ(path.sizeBuf(), 1002u);
    EXPECT_EQ(this->plain(path), "//");
}

#include "tests/files/path_kinds.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

template <class Kind>
class FPathFileUrl : public PathOfKind<Kind> {};
TYPED_TEST_SUITE(FPathFileUrl, PathKinds);

} // namespace

TYPED_TEST(FPathFileUrl, becomes_the_network_path_of_a_file_url) {
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

#include "host/xos_url/url_text.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

TEST(HostUrlText, tells_schemes_apart) {
    using host::Scheme;
    struct Case {
        Row row;
        char const* url;
        Scheme scheme;
    };
    for (Case const& c :
         {Case{{}, "http://x", Scheme::HTTP}, Case{{}, "HTTPS://x", Scheme::HTTPS}, Case{{}, "file:/x", Scheme::FILE},
          Case{{}, "File:", Scheme::FILE}, Case{{}, "http:x", Scheme::OTHER}, Case{{}, "http", Scheme::OTHER},
          Case{{}, "ftp://x", Scheme::OTHER}, Case{{}, "", Scheme::OTHER}, Case{{}, " http://x", Scheme::OTHER}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(host::schemeOf(c.url), c.scheme);
    }
}

TEST(HostUrlText, escapes_what_libraries_read_differently) {
    EXPECT_EQ(host::escapedUrl("http://x/a b"), "http://x/a%20b");
    EXPECT_EQ(host::escapedUrl("\x01\x20\x21\x7E\x7F\x80\xFF"), "%01%20!~%7F%80%FF");
    EXPECT_EQ(host::escapedUrl("a%20b?c=d#e"), "a%20b?c=d#e");
    EXPECT_EQ(host::escapedUrl(""), "");
}

TEST(HostUrlText, finds_host_and_path_of_a_file) {
    struct Case {
        Row row;
        char const* url;
        char const* host;
        char const* path;
    };
    for (Case const& c :
         {Case{{}, "file:///a/b", "", "/a/b"}, Case{{}, "file:/a", "", "/a"}, Case{{}, "file://localhost/a", "", "/a"},
          Case{{}, "FILE://LOCALHOST/a", "", "/a"}, Case{{}, "file://localhost2/a", "localhost2", "/a"},
          Case{{}, "file://server/share/x", "server", "/share/x"}, Case{{}, "file:///C:/a%20b", "", "/C:/a b"},
          Case{{}, "file:///a?q#f", "", "/a"}, Case{{}, "file:///%41%6a%2F", "", "/Aj/"},
          Case{{}, "file:////x", "", "//x"}}) {
        SCOPED_TRACE(c.row);
        auto const url = host::parseFileUrl(c.url);
        ASSERT_TRUE(url.has_value());
        EXPECT_EQ(url->host, c.host);
        EXPECT_EQ(url->path, c.path);
    }
}

TEST(HostUrlText, refuses_what_is_no_file_url) {
    for (char const* const url :
         {"", "file", "file:", "file:a", "file://", "file://host", "http:///a", "file:///%", "file:///%4",
          "file:///%4g", "file:///%-1", "file:///%00", "file:///%+1", "file:///% 1"}) {
        EXPECT_FALSE(host::parseFileUrl(url).has_value()) << url;
    }
}

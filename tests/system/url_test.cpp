#include <zor_basis/system/url.h>

#include <xos_host.h>

#include "tests/support/http_server.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <string>
#include <type_traits>
#include <utility>

using namespace ZOR_Basis;

namespace {

struct UrlGet : testing::Test {
    UrlGet() { xos_HostCallsReset(); }
    ~UrlGet() override { xos_HostFailClear(); }

    static constexpr bool OVERWRITE = true;
    static constexpr bool MAKE_DIRECTORY = true;

    bool get(std::string const& target, std::string const& url, bool overwrite, bool makeDirectory) const {
        return Url::Get((scratch / target).c_str(), url.c_str(), nullptr, nullptr, overwrite, makeDirectory);
    }
    std::string page() const { return server.url("/page"); }
    static std::string quoted(std::string const& text) { return '"' + text + '"'; }

    HttpServer const server{
        {{"/page", always(answer("200 OK", "the page"))}, {"/gone", always(answer("404 Not Found", "no page"))}}};
    Scratch scratch;
};

} // namespace

TEST_F(UrlGet, breathes) {
    EXPECT_TRUE(get("file", page(), false, false));
    EXPECT_EQ(textOf(scratch / "file"), "the page");
}

TEST_F(UrlGet, hands_everything_on) {
    EXPECT_TRUE(Url::Get((scratch / "file").c_str(), page().c_str(), "first", "second", false, false));
    EXPECT_EQ(std::string(xos_HostLastCall("xos_URLGet")),
              quoted(page()) + ", " + quoted(scratch / "file") + ", \"first\", \"second\"");
    EXPECT_TRUE(get("file", page(), OVERWRITE, false));
    EXPECT_EQ(std::string(xos_HostLastCall("xos_URLGet")),
              quoted(page()) + ", " + quoted(scratch / "file") + ", null, null");
}

TEST_F(UrlGet, leaves_alone_what_it_may_not_replace) {
    put(scratch / "file", "before");
    EXPECT_FALSE(get("file", page(), false, false));
    EXPECT_FALSE(get("file", page(), false, MAKE_DIRECTORY));
    EXPECT_EQ(textOf(scratch / "file"), "before");
    makeFolder(scratch / "folder");
    EXPECT_FALSE(get("folder", page(), false, false)) << "an entry of any kind";
    EXPECT_EQ(xos_HostCalls("xos_URLGet"), 0u) << "nothing is fetched";
    EXPECT_TRUE(get("file", page(), OVERWRITE, false));
    EXPECT_EQ(textOf(scratch / "file"), "the page");
}

TEST_F(UrlGet, makes_the_directory_when_asked) {
    EXPECT_FALSE(get("a/b/file", page(), false, false));
    EXPECT_EQ(scratch.content(), Names{});
    EXPECT_TRUE(get("a/b/file", page(), false, MAKE_DIRECTORY));
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/", "a/b/file"}));
}

TEST_F(UrlGet, fetches_nothing_where_the_directory_cannot_be_made) {
    put(scratch / "file", "in the way");
    EXPECT_FALSE(get("file/a/b", page(), OVERWRITE, MAKE_DIRECTORY));
    xos_HostFail("xos_DirCreateEx", 0, 100);
    EXPECT_FALSE(get("a/file", page(), OVERWRITE, MAKE_DIRECTORY));
    EXPECT_FALSE(Url::Get("file", page().c_str(), nullptr, nullptr, true, MAKE_DIRECTORY)) << "no directory to make";
    EXPECT_EQ(xos_HostCalls("xos_URLGet"), 0u);
    EXPECT_EQ(scratch.content(), Names{"file"});
}

TEST_F(UrlGet, fails_as_the_platform_does) {
    EXPECT_FALSE(get("file", server.url("/gone"), false, false));
    EXPECT_FALSE(get("file", "nonsense", false, false));
    xos_HostFail("xos_URLGet", 0, 1);
    EXPECT_FALSE(get("file", page(), false, false));
    EXPECT_EQ(scratch.content(), Names{});
    EXPECT_FALSE(get("a/file", server.url("/gone"), false, MAKE_DIRECTORY));
    EXPECT_EQ(scratch.content(), Names{"a/"}) << "which stays";
}

TEST_F(UrlGet, goes_on_where_the_status_cannot_be_asked_of_the_platform) {
    xos_HostFail("xos_FileStatByNameEx", 0, 100);
    EXPECT_TRUE(get("file", page(), false, false));
}

TEST_F(UrlGet, gives_up_without_a_target_or_a_url) {
    EXPECT_FALSE(Url::Get(nullptr, page().c_str(), nullptr, nullptr, true, false));
    EXPECT_FALSE(Url::Get(nullptr, page().c_str(), nullptr, nullptr, true, true));
    EXPECT_FALSE(Url::Get("", page().c_str(), nullptr, nullptr, true, false));
    EXPECT_FALSE(Url::Get((scratch / "file").c_str(), nullptr, nullptr, nullptr, true, false));
    EXPECT_EQ(scratch.content(), Names{});
}

TEST(Url, has_nothing_to_assign) {
    static_assert(std::is_empty_v<Url>);
    Url a;
    Url const b;
    EXPECT_EQ(&(a = b), &a);
    EXPECT_EQ(&(a = Url()), &a);
}

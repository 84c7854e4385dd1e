#include "tests/support/http_server.h"
#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

TEST(Fetch, fetches_a_page_into_a_file) {
    Tool tool;
    HttpServer server({{"/page", always(answer("200 OK", "the page"))}});
    EXPECT_EQ(tool.run({"url", "get", server.url("/page"), "page"}), (ToolResult{0, "", ""}));
    EXPECT_EQ(textOf(tool / "page"), "the page");
    put(tool / "page", "older");
    ToolResult const refused = tool.run({"url", "get", server.url("/page"), "page"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_TRUE(isOneLineAbout(refused.errors, "page"));
    EXPECT_EQ(textOf(tool / "page"), "older");
    EXPECT_EQ(tool.run({"url", "get", "--overwrite", server.url("/page"), "page"}).code, 0);
    EXPECT_EQ(textOf(tool / "page"), "the page");
}

TEST(Fetch, tells_what_is_missing_or_forbidden_and_never_a_password) {
    Tool tool;
    HttpServer server(
        {{"/gone", always(answer("404 Not Found", "no"))}, {"/closed", always(answer("403 Forbidden", "no"))}});
    for (char const* target : {"/gone", "/closed"}) {
        SCOPED_TRACE(target);
        std::string url = server.url(target);
        ToolResult const result = tool.run({"url", "get", url.insert(7, "user:hush@"), "page"});
        EXPECT_EQ(result.code, 1);
        EXPECT_TRUE(isOneLineAbout(result.errors, "'" + server.url(target) + "'"));
        EXPECT_EQ(result.errors.find("hush"), std::string::npos);
        EXPECT_EQ(tool.content(), Names{});
    }
    EXPECT_TRUE(isOneLineAbout(tool.run({"url", "get", "bogus:x", "page"}).errors, "'bogus:x'"));
    EXPECT_TRUE(isOneLineAbout(
        tool.run({"url", "get", server.url("/"), "page", "--user", "u", "--password-file", "gone"}).errors, "gone"));
    EXPECT_EQ(tool.run({"url", "get"}).code, 2);
    EXPECT_EQ(tool.run({"url"}).code, 2);
}

TEST(Fetch, never_replaces_the_password_file) {
    Tool tool;
    HttpServer server({{"/page", always(answer("200 OK", "the page"))}});
    put(tool / "password", "hush\n");
    for (std::string const target : {"password", "./password"}) {
        SCOPED_TRACE(target);
        ToolResult const refused = tool.run(
            {"url", "get", "--overwrite", server.url("/page"), target, "--user", "u", "--password-file", "password"});
        EXPECT_EQ(refused, (ToolResult{1, "", "zbtool: " + target + ": is the password's file\n"}));
        EXPECT_EQ(textOf(tool / "password"), "hush\n");
    }
    EXPECT_EQ(tool.run({"url", "get", server.url("/page"), "page", "--user", "u", "--password-file", "password"}).code,
              0);
    EXPECT_EQ(tool.content(), (Names{"page", "password"}));
}

} // namespace

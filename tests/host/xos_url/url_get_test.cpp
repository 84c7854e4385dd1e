#include "basis/platform/xos_url.h"
#include "tests/host/support/child.h"
#include "tests/host/xos_url/fetched_files.h"
#include "tests/support/http_server.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <chrono>
#include <cstdint>
#include <cstring>
#include <filesystem>
#include <string>
#include <thread>
#include <vector>

namespace {

using namespace std::chrono_literals;

std::string redirect(std::string const& location, std::string const& status = "302 Found") {
    return answer(status, "<p>it moved</p>", "Location: " + location + "\r\n");
}

struct HostUrl : FetchedFiles {};

TEST_F(HostUrl, fetches_a_page_into_a_file) {
    HttpServer const server{{{"/page", always(answer("200 OK", "the page"))}}};
    EXPECT_EQ(get(server.url("/page"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "the page");
    EXPECT_EQ(scratch.content(), Names{"target"});
}

TEST_F(HostUrl, replaces_a_file_as_a_whole) {
    HttpServer const server{{{"/page", always(answer("200 OK", "new"))}}};
    put(scratch / "target", "something longer that was here before");
    EXPECT_EQ(get(server.url("/page"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "new");
}

TEST_F(HostUrl, stores_bodies_byte_for_byte) {
    std::string every;
    for (int i = 0; i < 100'000; ++i) { every += static_cast<char>(i * 7 + i / 256); }
    HttpServer const server{{{"/every", always(answer("200 OK", every))},
                             {"/empty", always(answer("200 OK", ""))},
                             {"/lines", always(answer("200 OK", "a\r\nb\nc\x1A"))},
                             {"/nothing", always("HTTP/1.1 204 No Content\r\nConnection: close\r\n\r\n")}}};
    struct Case {
        Row row;
        char const* target;
        std::string body;
    };
    for (Case const& c : {Case{{}, "/every", every}, Case{{}, "/empty", ""}, Case{{}, "/lines", "a\r\nb\nc\x1A"},
                          Case{{}, "/nothing", ""}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(get(server.url(c.target), scratch / "target"), 0);
        EXPECT_TRUE(exists(scratch / "target"));
        EXPECT_EQ(textOf(scratch / "target"), c.body);
    }
}

TEST_F(HostUrl, fails_on_every_answer_that_is_no_success) {
    for (char const* const status :
         {"304 Not Modified", "400 Bad Request", "401 Unauthorized", "403 Forbidden", "404 Not Found", "410 Gone",
          "500 Internal Server Error", "503 Service Unavailable"}) {
        SCOPED_TRACE(status);
        HttpServer const server{{{"/page", always(answer(status, "why"))}}};
        expectFailure(server.url("/page"));
    }
}

TEST_F(HostUrl, follows_redirects) {
    HttpServer const other{{{"/there", always(answer("200 OK", "on the other server"))}}};
    HttpServer const server{{{"/page", always(answer("200 OK", "the page"))},
                             {"/301", always(redirect("/page", "301 Moved Permanently"))},
                             {"/302", always(redirect("/301"))},
                             {"/307", always(redirect("/302", "307 Temporary Redirect"))},
                             {"/308", always(redirect("page", "308 Permanent Redirect"))},
                             {"/away", always(redirect(other.url("/there")))}}};
    struct Case {
        Row row;
        char const* target;
        char const* body;
    };
    for (Case const& c : {Case{{}, "/301", "the page"}, Case{{}, "/302", "the page"}, Case{{}, "/307", "the page"},
                          Case{{}, "/308", "the page"}, Case{{}, "/away", "on the other server"}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(get(server.url(c.target), scratch / "target"), 0);
        EXPECT_EQ(textOf(scratch / "target"), c.body);
    }
}

TEST_F(HostUrl, fails_on_redirects_that_lead_nowhere) {
    HttpServer const server{{{"/circle", always(redirect("/circle"))},
                             {"/gone", always(redirect("/missing"))},
                             {"/local", always(redirect("file:///etc/passwd"))}}};
    expectFailure(server.url("/circle"));
    EXPECT_LT(server.asked().size(), 30u);
    expectFailure(server.url("/gone"));
    expectFailure(server.url("/local"));
}

TEST_F(HostUrl, fails_where_nobody_listens) {
    std::string address;
    {
        HttpServer const server{{}};
        address = server.url("/page");
    }
    expectFailure(address);
    expectFailure("http://no-such-host.invalid/page");
}

TEST_F(HostUrl, fails_on_a_body_that_is_cut) {
    HttpServer const server{
        {{"/length", always("HTTP/1.1 200 OK\r\nConnection: close\r\nContent-Length: 1000\r\n\r\nonly this")},
         {"/nothing", always("")},
         {"/rubbish", always("what do you want?\r\n\r\n")}}};
    for (char const* const target : {"/length", "/nothing", "/rubbish"}) {
        SCOPED_TRACE(target);
        expectFailure(server.url(target));
    }
}

TEST_F(HostUrl, takes_bodies_in_chunks_and_bodies_that_end_with_the_connection) {
    HttpServer const server{
        {{"/chunks", always("HTTP/1.1 200 OK\r\nConnection: close\r\nTransfer-Encoding: chunked\r\n\r\n"
                            "4\r\nfour\r\n6\r\n, six!\r\n0\r\n\r\n")},
         {"/close", always("HTTP/1.1 200 OK\r\nConnection: close\r\n\r\nto the end")}}};
    EXPECT_EQ(get(server.url("/chunks"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "four, six!");
    EXPECT_EQ(get(server.url("/close"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "to the end");
}

TEST_F(HostUrl, waits_for_a_slow_server_and_shows_nothing_before_the_end) {
    HttpServer const server{{{"/slow", [&](Socket socket, HttpRequest const&) {
                                  std::string const text = answer("200 OK", "slowly but surely");
                                  for (char const& c : text) {
                                      if (&c - text.data() > 60) { EXPECT_FALSE(exists(scratch / "target")); }
                                      sendAll(socket, &c, 1);
                                      std::this_thread::sleep_for(4ms);
                                  }
                              }}}};
    EXPECT_EQ(get(server.url("/slow"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "slowly but surely");
}

/// Lets in who knows the password, as basic authentication has it.
HttpServer::Handler guarded(std::string const& encoded) {
    return [encoded](Socket socket, HttpRequest const& request) {
        auto const found = request.headers.find("authorization");
        bool const isKnown = found != request.headers.end() && found->second == "Basic " + encoded;
        std::string const text =
            isKnown ? answer("200 OK", "welcome")
                    : answer("401 Unauthorized", "who are you?", "WWW-Authenticate: Basic realm=\"test\"\r\n");
        sendAll(socket, text.data(), text.size());
    };
}

TEST_F(HostUrl, gives_name_and_password_where_they_are_asked_for) {
    HttpServer const server{{{"/guarded", guarded("dXNlcjpzZWNyZXQ=")}, // user:secret
                             {"/nopassword", guarded("dXNlcjo=")},      // user:
                             {"/moved", always(redirect("/guarded"))},
                             {"/open", always(answer("200 OK", "come in"))}}};
    EXPECT_EQ(get(server.url("/guarded"), scratch / "target", "user", "secret"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "welcome");
    EXPECT_EQ(get(server.url("/moved"), scratch / "moved", "user", "secret"), 0);
    EXPECT_EQ(textOf(scratch / "moved"), "welcome");
    EXPECT_EQ(get("http://user:secret@" + server.address() + "/guarded", scratch / "inside"), 0);
    EXPECT_EQ(textOf(scratch / "inside"), "welcome");
    EXPECT_EQ(get(server.url("/nopassword"), scratch / "none", "user", nullptr), 0);
    EXPECT_EQ(textOf(scratch / "none"), "welcome");
    EXPECT_EQ(get(server.url("/open"), scratch / "open", "user", "secret"), 0);
    EXPECT_EQ(textOf(scratch / "open"), "come in");
}

TEST_F(HostUrl, gives_the_password_to_no_server_but_the_one_that_is_named) {
    HttpServer const other{{{"/guarded", guarded("dXNlcjpzZWNyZXQ=")}}};
    HttpServer const server{{{"/away", always(redirect(other.url("/guarded")))}}};
    expectFailure(server.url("/away"), "user", "secret");
}

TEST_F(HostUrl, fails_with_a_wrong_password_or_none) {
    HttpServer const server{{{"/guarded", guarded("dXNlcjpzZWNyZXQ=")}}};
    expectFailure(server.url("/guarded"));
    expectFailure(server.url("/guarded"), "user", "wrong");
    expectFailure(server.url("/guarded"), "someone", "secret");
    EXPECT_LT(server.asked().size(), 20u);
}

TEST_F(HostUrl, fetches_100_mebibytes_in_constant_memory) {
    constexpr std::uint64_t PIECE = 1 << 20;
    constexpr std::uint64_t PIECES = 100;
    constexpr std::uint64_t MOST_MORE = 24 * PIECE;
    HttpServer const server{{{"/large",
                              [](Socket socket, HttpRequest const&) {
                                  std::string const head = "HTTP/1.1 200 OK\r\nConnection: close\r\nContent-Length: " +
                                                           std::to_string(PIECE * PIECES) + "\r\n\r\n";
                                  sendAll(socket, head.data(), head.size());
                                  std::string const piece(PIECE, 'x');
                                  for (std::uint64_t i = 0; i < PIECES; ++i) { sendAll(socket, piece.data(), PIECE); }
                              }},
                             {"/small", always(answer("200 OK", "warm"))}}};
    EXPECT_EQ(get(server.url("/small"), scratch / "target"), 0);
    std::uint64_t const before = peakMemory();
    EXPECT_EQ(get(server.url("/large"), scratch / "target"), 0);
    EXPECT_LT(peakMemory(), before + MOST_MORE);
    EXPECT_EQ(std::filesystem::file_size(scratch / "target"), PIECE * PIECES);
}

TEST_F(HostUrl, asks_for_what_the_url_says) {
    HttpServer const server{{{"/a/b.txt?x=1&y=%20", always(answer("200 OK", "query"))},
                             {"/with%20blank", always(answer("200 OK", "blank"))},
                             {"/", always(answer("200 OK", "top"))}}};
    EXPECT_EQ(get(server.url("/a/b.txt?x=1&y=%20"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "query");
    EXPECT_EQ(get(server.url("/with blank"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "blank");
    EXPECT_EQ(get(server.url("/#part"), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "top");
    EXPECT_EQ(get("HTTP://" + server.address(), scratch / "target"), 0);
    EXPECT_EQ(textOf(scratch / "target"), "top");
}

TEST_F(HostUrl, fetches_several_at_a_time) {
    HttpServer const server{{{"/page", always(answer("200 OK", std::string(200'000, 'p')))}}};
    std::vector<std::thread> threads;
    for (int i = 0; i < 6; ++i) {
        threads.emplace_back([&, i] { EXPECT_EQ(get(server.url("/page"), scratch / std::to_string(i)), 0); });
    }
    for (std::thread& thread : threads) { thread.join(); }
    EXPECT_EQ(scratch.content().size(), 6u);
    for (int i = 0; i < 6; ++i) { EXPECT_EQ(textOf(scratch / std::to_string(i)).size(), 200'000u); }
}

TEST_F(HostUrl, fails_where_the_target_cannot_be_written) {
    HttpServer const server{{{"/page", always(answer("200 OK", "the page"))}}};
    makeFolder(scratch / "folder/inside");
    EXPECT_NE(get(server.url("/page"), scratch / "missing/target"), 0);
    EXPECT_NE(get(server.url("/page"), scratch / "folder"), 0);
    EXPECT_NE(get(server.url("/page"), ""), 0);
    EXPECT_EQ(scratch.content(), (Names{"folder/", "folder/inside/"}));
}

TEST_F(HostUrl, fails_on_what_is_no_url_that_it_knows) {
    for (char const* const url :
         {"", "page", "/etc/passwd", "ftp://127.0.0.1/x", "gopher://127.0.0.1/", "http:", "http://",
          "httpx://127.0.0.1/", "file", "file:", "file://", "file:relative", "://"}) {
        SCOPED_TRACE(url);
        expectFailure(url);
    }
    EXPECT_NE(xos_URLGet(nullptr, (scratch / "x").c_str(), nullptr, nullptr), 0);
    EXPECT_NE(xos_URLGet("file:///x", nullptr, nullptr, nullptr), 0);
}

} // namespace

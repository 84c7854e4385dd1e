// Answers without a length that are cut. WinHTTP takes what came before the cut for the whole answer, so this can hold
// on this system only.

#include "basis/platform/xos_url.h"
#include "tests/support/http_server.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

namespace {

TEST(HostUrlPosix, fails_on_a_cut_head_and_on_cut_chunks) {
    HttpServer const server{
        {{"/head", always("HTTP/1.1 200 OK\r\nContent-Le")},
         {"/status", always("HTTP/1.1 200 OK\r\n")},
         {"/chunk",
          always("HTTP/1.1 200 OK\r\nConnection: close\r\nTransfer-Encoding: chunked\r\n\r\n64\r\nonly this")},
         {"/last", always("HTTP/1.1 200 OK\r\nConnection: close\r\nTransfer-Encoding: chunked\r\n\r\n4\r\nonly\r\n")}}};
    Scratch const scratch;
    for (char const* const target : {"/head", "/status", "/chunk", "/last"}) {
        SCOPED_TRACE(target);
        EXPECT_NE(xos_URLGet(server.url(target).c_str(), (scratch / "target").c_str(), nullptr, nullptr), 0);
        EXPECT_EQ(scratch.content(), Names{});
    }
}

TEST(HostUrlPosix, takes_chunks_with_trailing_headers) {
    HttpServer const server{
        {{"/trailer", always("HTTP/1.1 200 OK\r\nConnection: close\r\nTransfer-Encoding: chunked\r\n\r\n4\r\nfour\r\n"
                             "0\r\nX-Check: 1\r\n\r\n")}}};
    Scratch const scratch;
    EXPECT_EQ(xos_URLGet(server.url("/trailer").c_str(), (scratch / "target").c_str(), nullptr, nullptr), 0);
    EXPECT_EQ(textOf(scratch / "target"), "four");
}

} // namespace

#include "tests/support/http_server.h"
#include "tests/support/wait_for.h"
#include "tests/zbtool/prepared_child_posix.h"
#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

#include <csignal>

namespace {

TEST(FetchPosix, leaves_nothing_when_interrupted) {
    std::string const begun = answer("200 OK", std::string(100'000, 'x')).substr(0, 60'000);
    std::atomic<bool> isOver{false};
    HttpServer server({{"/endless", [&](Socket socket, HttpRequest const&) {
                            sendAll(socket, begun.data(), begun.size());
                            waitFor([&] { return isOver.load(); });
                        }}});
    for (std::vector<int> const& signals : {std::vector{SIGINT}, {SIGTERM}, {SIGINT, SIGTERM}}) {
        Tool tool;
        put(tool / "page", "older");
        PreparedChild child({ZBTOOL, "url", "get", "--overwrite", server.url("/endless"), "page"}, tool.path(),
                            [] { return true; });
        auto const isWriting = [&] {
            for (std::string const& name : tool.content()) {
                if (name.ends_with(".part")) return true;
            }
            return false;
        };
        EXPECT_TRUE(waitFor(isWriting));
        for (int const signal : signals) ::kill(child.process(), signal);
        auto const end = child.wait();
        EXPECT_EQ(end.signal, signals[0]);
        EXPECT_EQ(end.errors, "");
        EXPECT_EQ(tool.content(), Names{"page"});
        EXPECT_EQ(textOf(tool / "page"), "older");
    }
    isOver = true;
}

} // namespace

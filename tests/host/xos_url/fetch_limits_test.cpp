#include "host/xos_url/fetch.h"
#include "tests/support/http_server.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <string>
#include <thread>

namespace {

using namespace std::chrono_literals;

class TextSink : public host::BodySink {
public:
    explicit TextSink(std::size_t most = std::string::npos) : most_(most) {}
    bool take(void const* data, std::size_t size) override {
        text_.append(static_cast<char const*>(data), size);
        return text_.size() <= most_;
    }
    std::string const& text() const { return text_; }

private:
    std::size_t most_;
    std::string text_;
};

TEST(HostFetch, gives_up_on_a_server_that_falls_silent) {
    std::atomic<bool> isOver{false};
    HttpServer const server{{{"/silent", [&](Socket socket, HttpRequest const&) {
                                  std::string const start = "HTTP/1.1 200 OK\r\nContent-Length: 100\r\n\r\nand then";
                                  sendAll(socket, start.data(), start.size());
                                  for (int i = 0; i < 1500 && !isOver; ++i) { std::this_thread::sleep_for(10ms); }
                              }}}};
    TextSink sink;
    auto const start = std::chrono::steady_clock::now();
    EXPECT_FALSE(host::fetch({server.url("/silent"), nullptr, nullptr, 5, 1}, sink));
    EXPECT_LT(std::chrono::steady_clock::now() - start, 10s);
    isOver = true;
}

TEST(HostFetch, ends_when_the_body_cannot_be_stored) {
    HttpServer const server{{{"/page", always(answer("200 OK", std::string(1'000'000, 'x')))}}};
    TextSink sink{100'000};
    EXPECT_FALSE(host::fetch({server.url("/page"), nullptr, nullptr, 5, 5}, sink));
    EXPECT_LT(sink.text().size(), 300'000u);
}

TEST(HostFetch, hands_over_only_the_body_of_the_last_answer) {
    HttpServer const server{{{"/page", always(answer("200 OK", "the page"))},
                             {"/moved", always(answer("302 Found", "it moved", "Location: /page\r\n"))}}};
    TextSink sink;
    EXPECT_TRUE(host::fetch({server.url("/moved"), nullptr, nullptr, 5, 5}, sink));
    EXPECT_EQ(sink.text(), "the page");
}

} // namespace

/// \file
/// A small HTTP server on the loopback interface, for as long as the object lives.

#ifndef TESTS_SUPPORT_HTTP_SERVER_H
#define TESTS_SUPPORT_HTTP_SERVER_H

#include "tests/support/sockets.h"

#include <atomic>
#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

struct HttpRequest {
    std::string target;
    /// Names in lower case.
    std::map<std::string, std::string> headers;
};

class HttpServer {
public:
    /// Answers one request on its connection, which is closed afterwards.
    using Handler = std::function<void(Socket, HttpRequest const&)>;

    explicit HttpServer(std::map<std::string, Handler> handlers);
    HttpServer(HttpServer const&) = delete;
    HttpServer& operator=(HttpServer const&) = delete;
    ~HttpServer();

    std::string url(std::string const& target) const;
    std::string address() const { return "127.0.0.1:" + std::to_string(port_); }
    /// The targets that were asked for, in order.
    std::vector<std::string> asked() const;

private:
    void listen();
    void serve(Socket socket);

    std::map<std::string, Handler> handlers_;
    std::uint16_t port_{0};
    Socket listener_;
    std::atomic<bool> stop_{false};
    mutable std::mutex mutex_;
    std::vector<std::string> asked_;
    std::vector<std::thread> connections_;
    std::thread thread_;
};

/// A whole answer: status line, length, further header lines (each with its line end), body.
std::string answer(std::string const& status, std::string const& body, std::string const& headers = "");

/// Answers the same whatever is asked.
HttpServer::Handler always(std::string const& text);

#endif

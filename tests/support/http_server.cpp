#include "tests/support/http_server.h"

#include <algorithm>
#include <cctype>
#include <utility>

namespace {

std::string receiveHead(Socket socket) {
    std::string head;
    while (head.find("\r\n\r\n") == std::string::npos) {
        std::string const piece = receiveSome(socket);
        if (piece.empty()) return {};
        head += piece;
    }
    return head;
}

HttpRequest parse(std::string const& head) {
    HttpRequest request;
    std::size_t const blank = head.find(' ');
    request.target = head.substr(blank + 1, head.find(' ', blank + 1) - blank - 1);
    std::size_t line = head.find("\r\n") + 2;
    while (head.compare(line, 2, "\r\n") != 0) {
        std::size_t const end = head.find("\r\n", line);
        std::size_t const colon = head.find(": ", line);
        std::string name = head.substr(line, colon - line);
        std::transform(name.begin(), name.end(), name.begin(), [](unsigned char c) { return std::tolower(c); });
        request.headers[name] = head.substr(colon + 2, end - colon - 2);
        line = end + 2;
    }
    return request;
}

} // namespace

HttpServer::HttpServer(std::map<std::string, Handler> handlers)
    : handlers_(std::move(handlers)), listener_(listenOnLoopback(port_)), thread_([this] { listen(); }) {}

HttpServer::~HttpServer() {
    stop_ = true;
    thread_.join();
    for (std::thread& connection : connections_) { connection.join(); }
    closeSocket(listener_);
}

std::string HttpServer::url(std::string const& target) const { return "http://" + address() + target; }

std::vector<std::string> HttpServer::asked() const {
    std::lock_guard const lock{mutex_};
    return asked_;
}

void HttpServer::listen() {
    constexpr int LOOK_AGAIN_MS = 20;
    while (!stop_) {
        Socket const socket = acceptWithin(listener_, LOOK_AGAIN_MS);
        if (socket != NO_SOCKET) {
            connections_.emplace_back([this, socket] { serve(socket); });
        }
    }
}

void HttpServer::serve(Socket socket) {
    std::string const head = receiveHead(socket);
    if (!head.empty()) {
        HttpRequest const request = parse(head);
        {
            std::lock_guard const lock{mutex_};
            asked_.push_back(request.target);
        }
        auto const handler = handlers_.find(request.target);
        if (handler != handlers_.end()) {
            handler->second(socket, request);
        } else {
            always(answer("404 Not Found", "there is no such page"))(socket, request);
        }
    }
    closeSocket(socket);
}

std::string answer(std::string const& status, std::string const& body, std::string const& headers) {
    return "HTTP/1.1 " + status + "\r\nConnection: close\r\nContent-Length: " + std::to_string(body.size()) + "\r\n" +
           headers + "\r\n" + body;
}

HttpServer::Handler always(std::string const& text) {
    return [text](Socket socket, HttpRequest const&) { sendAll(socket, text.data(), text.size()); };
}

// The sibling is sockets_win.cpp.

#include "tests/support/sockets.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

Socket listenOnLoopback(std::uint16_t& port) {
    int const listener = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t size = sizeof address;
    auto* const generic = reinterpret_cast<sockaddr*>(&address);
    bind(listener, generic, size);
    listen(listener, SOMAXCONN);
    getsockname(listener, generic, &size);
    port = ntohs(address.sin_port);
    return listener;
}

Socket acceptWithin(Socket listener, int milliseconds) {
    pollfd wait{static_cast<int>(listener), POLLIN, 0};
    return poll(&wait, 1, milliseconds) == 1 ? accept(static_cast<int>(listener), nullptr, nullptr) : NO_SOCKET;
}

std::string receiveSome(Socket socket) {
    char buffer[4096];
    pollfd wait{static_cast<int>(socket), POLLIN, 0};
    constexpr int LONGEST_MS = 20'000;
    if (poll(&wait, 1, LONGEST_MS) != 1) return {};
    ssize_t const count = recv(static_cast<int>(socket), buffer, sizeof buffer, 0);
    return {buffer, static_cast<std::size_t>(count < 0 ? 0 : count)};
}

bool sendAll(Socket socket, char const* data, std::size_t size) {
    while (size != 0) {
        ssize_t const count = send(static_cast<int>(socket), data, size, MSG_NOSIGNAL);
        if (count <= 0) return false;
        data += count;
        size -= static_cast<std::size_t>(count);
    }
    return true;
}

void closeSocket(Socket socket) {
    shutdown(static_cast<int>(socket), SHUT_RDWR);
    close(static_cast<int>(socket));
}

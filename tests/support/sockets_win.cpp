// The sibling is sockets_posix.cpp.

#include "tests/support/sockets.h"

#include <winsock2.h>
#include <ws2tcpip.h>

namespace {

SOCKET handleOf(Socket socket) { return static_cast<SOCKET>(socket); }

bool isReadable(Socket socket, int milliseconds) {
    fd_set set;
    FD_ZERO(&set);
    FD_SET(handleOf(socket), &set);
    timeval time{milliseconds / 1000, milliseconds % 1000 * 1000};
    return select(0, &set, nullptr, nullptr, &time) == 1;
}

} // namespace

Socket listenOnLoopback(std::uint16_t& port) {
    WSADATA data;
    WSAStartup(MAKEWORD(2, 2), &data);
    SOCKET const listener = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    int size = sizeof address;
    auto* const generic = reinterpret_cast<sockaddr*>(&address);
    bind(listener, generic, size);
    listen(listener, SOMAXCONN);
    getsockname(listener, generic, &size);
    port = ntohs(address.sin_port);
    return static_cast<Socket>(listener);
}

Socket acceptWithin(Socket listener, int milliseconds) {
    if (!isReadable(listener, milliseconds)) return NO_SOCKET;
    return static_cast<Socket>(accept(handleOf(listener), nullptr, nullptr));
}

std::string receiveSome(Socket socket) {
    char buffer[4096];
    constexpr int LONGEST_MS = 20'000;
    if (!isReadable(socket, LONGEST_MS)) return {};
    int const count = recv(handleOf(socket), buffer, sizeof buffer, 0);
    return {buffer, static_cast<std::size_t>(count < 0 ? 0 : count)};
}

bool sendAll(Socket socket, char const* data, std::size_t size) {
    while (size != 0) {
        int const count = send(handleOf(socket), data, static_cast<int>(size), 0);
        if (count <= 0) return false;
        data += count;
        size -= static_cast<std::size_t>(count);
    }
    return true;
}

void closeSocket(Socket socket) {
    shutdown(handleOf(socket), SD_BOTH);
    closesocket(handleOf(socket));
}

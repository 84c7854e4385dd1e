/// \file
/// A listening TCP socket on the loopback interface. Twins: sockets_posix.cpp, sockets_win.cpp.

#ifndef TESTS_SUPPORT_SOCKETS_H
#define TESTS_SUPPORT_SOCKETS_H

#include <cstddef>
#include <cstdint>
#include <string>

using Socket = std::intptr_t;
constexpr Socket NO_SOCKET = -1;

/// Listens at a port of the system's choice.
Socket listenOnLoopback(std::uint16_t& port);

/// \return `NO_SOCKET` when nobody has come within the time
Socket acceptWithin(Socket listener, int milliseconds);

/// \return what has arrived; empty at the end
std::string receiveSome(Socket socket);

/// \return false: the other side is gone
bool sendAll(Socket socket, char const* data, std::size_t size);

void closeSocket(Socket socket);

#endif

#include <zor_basis/files/f_stat.h>

#include "tests/files/wide_names_posix.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cstring>

using namespace ZOR_Basis;

TEST(FStatPosix, sees_no_directory_in_a_socket_by_a_wide_path) {
    Scratch const scratch;
    std::string const path = scratch / "s";
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    ASSERT_LT(path.size(), sizeof address.sun_path);
    std::strcpy(address.sun_path, path.c_str());
    int const socket = ::socket(AF_UNIX, SOCK_STREAM, 0);
    ASSERT_EQ(::bind(socket, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    ::close(socket);
    // The type bits of a socket contain those of a directory.
    EXPECT_EQ(FStat(wideOf(path).c_str()).type(), FStat::ST_FILE);
    EXPECT_EQ(FStat(path.c_str()).type(), FStat::ST_OTHER);
}

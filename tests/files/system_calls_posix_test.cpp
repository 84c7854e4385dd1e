#include "basis/files/system_calls.h"
#include "tests/support/scratch.h"
#include "tests/support/skip.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <string>
#include <tuple>
#include <unistd.h>

using namespace ZOR_Basis;

namespace {

using Numbers = std::tuple<int, int, int>;

Numbers numbersOf(xos_Stat const& record) { return {record.st_nlink_, record.st_uid_, record.st_gid_}; }

/// What the library's own call and the platform layer say, which must be one.
Numbers numbersOf(std::string const& path) {
    xos_Stat own{};
    xos_Stat platform{};
    EXPECT_TRUE(systemCalls.status(path.c_str(), own));
    EXPECT_EQ(xos_FileStatByNameEx(path.c_str(), &platform, 0), 0);
    EXPECT_EQ(numbersOf(own), numbersOf(platform));
    return numbersOf(own);
}

TEST(SystemCallsPosix, give_ids_that_do_not_fit_as_the_largest_that_do) {
    struct Case {
        uid_t user;
        gid_t group;
        Numbers expected;
    };
    if (::geteuid() != 0) CASE_CANNOT_HOLD("giving files away needs privilege");
    Scratch const scratch;
    put(scratch / "file", "");
    for (Case const& c : {Case{1, 32767, {1, 1, 32767}}, Case{32768, 65535, {1, 32767, 32767}},
                          Case{65536, 4'000'000'000, {1, 32767, 32767}}}) {
        ASSERT_EQ(::chown((scratch / "file").c_str(), c.user, c.group), 0);
        EXPECT_EQ(numbersOf(scratch / "file"), c.expected) << c.user;
    }
}

TEST(SystemCallsPosix, give_so_many_links_as_fit) {
    constexpr int LINKS = 33'000;
    Scratch const scratch;
    put(scratch / "file", "");
    for (int i = 1; i < LINKS; ++i) {
        std::string const name = scratch / std::to_string(i);
        if (::link((scratch / "file").c_str(), name.c_str()) != 0) CASE_CANNOT_HOLD("no so many links here");
    }
    EXPECT_EQ(std::get<0>(numbersOf(scratch / "file")), 32767);
}

TEST(SystemCallsPosix, give_the_codes_that_retries_are_decided_by) {
    struct Case {
        Row row;
        int error;
        std::uint32_t code;
    };
    for (Case const& c : {
             Case{{}, 0, NO_ERROR_YET},
             Case{{}, ENOENT, FILE_NOT_FOUND},
             Case{{}, ENOTDIR, PATH_NOT_FOUND},
             Case{{}, EACCES, ACCESS_DENIED},
             Case{{}, EPERM, GENERAL_FAILURE},
             Case{{}, ESTALE, NETWORK_NAME_GONE},
             Case{{}, EHOSTDOWN, NETWORK_NAME_GONE},
             Case{{}, EHOSTUNREACH, NETWORK_NAME_GONE},
             Case{{}, ENETDOWN, NETWORK_NAME_GONE},
             Case{{}, ENETUNREACH, NETWORK_NAME_GONE},
             Case{{}, ENETRESET, NETWORK_NAME_GONE},
             Case{{}, ENOLINK, NETWORK_NAME_GONE},
             Case{{}, EREMOTEIO, NETWORK_NAME_GONE},
             Case{{}, EKEYREJECTED, LOGON_FAILURE},
             Case{{}, EKEYEXPIRED, LOGON_FAILURE},
             Case{{}, EKEYREVOKED, LOGON_FAILURE},
             Case{{}, ENOKEY, LOGON_FAILURE},
         }) {
        SCOPED_TRACE(c.row);
        errno = c.error;
        EXPECT_EQ(systemCalls.lastError(), c.code);
    }
}

TEST(SystemCallsPosix, sleep_as_long_as_the_tick_says) {
    std::uint64_t const before = systemCalls.tick();
    systemCalls.sleep(30);
    EXPECT_GE(systemCalls.tick() - before, 29u);
}

} // namespace

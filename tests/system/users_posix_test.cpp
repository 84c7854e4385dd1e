// Users and domains on Linux, with a password database, a resolver and sessions of the tests' own.

#include <zor_basis/system.h>

#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "tests/system/query_calls_test_posix.h"

#include <unistd.h>
#include <utmpx.h>

#include <cerrno>
#include <cstring>

using namespace ZOR_Basis;

namespace {

using UsersPosix = QueryCallsTest;

/// A password database that knows users 1000 and 1001, and wants so much room for their records.
std::size_t roomWanted = 0;

int userById(uid_t user, passwd* record, char* buffer, std::size_t n, passwd** found) {
    *found = nullptr;
    if (n < roomWanted) return ERANGE;
    if (user != 1000 && user != 1001) return 0;
    *record = {};
    record->pw_uid = user;
    record->pw_name = buffer;
    std::strcpy(buffer, user == 1000 ? "session" : "a rather long thread's user");
    *found = record;
    return 0;
}

int brokenDatabase(uid_t, passwd*, char*, std::size_t, passwd** found) {
    *found = nullptr;
    return EIO;
}

uid_t id1000() { return 1000; }
uid_t id1001() { return 1001; }
uid_t id4711() { return 4711; }

char const* resolvedDomain = nullptr;
bool resolve(BufStr<15>& domain) {
    domain = resolvedDomain != nullptr ? resolvedDomain : "half";
    return resolvedDomain != nullptr;
}

struct Session {
    short type;
    char const *line, *user;
};

std::string recordsOf(std::initializer_list<Session> sessions) {
    std::string bytes;
    for (Session const& session : sessions) {
        utmpx record{};
        record.ut_type = session.type;
        std::memcpy(record.ut_line, session.line, std::strlen(session.line));
        std::memcpy(record.ut_user, session.user, std::strlen(session.user));
        bytes.append(reinterpret_cast<char const*>(&record), sizeof record);
    }
    return bytes;
}

} // namespace

TEST_F(UsersPosix, are_those_of_the_process_and_of_the_thread) {
    queryCalls.userById = userById;
    queryCalls.realUser = id1000;
    queryCalls.effectiveUser = id1001;
    for (std::size_t room : {0, 1024, 1025, 100'000}) {
        roomWanted = room;
        BufStr<15> user("before");
        EXPECT_TRUE(Sys::CurrentUser(user, true));
        EXPECT_STREQ(user.c_str(), "session");
        EXPECT_TRUE(Sys::CurrentUser(user, false));
        EXPECT_STREQ(user.c_str(), "a rather long thread's user");
    }
}

TEST_F(UsersPosix, are_nobody_where_the_database_does_not_know) {
    queryCalls.userById = userById;
    queryCalls.realUser = id4711;
    queryCalls.effectiveUser = id1000;
    roomWanted = 0;
    BufStr<15> user("before");
    EXPECT_FALSE(Sys::CurrentUser(user, true));
    EXPECT_STREQ(user.c_str(), "");
    roomWanted = std::size_t{1} << 30;
    user = "before";
    EXPECT_FALSE(Sys::CurrentUser(user, false)) << "no record is that long";
    EXPECT_STREQ(user.c_str(), "");
    queryCalls.userById = brokenDatabase;
    EXPECT_FALSE(Sys::CurrentUser(user, false));
    EXPECT_FALSE(Sys::CurHumanUser(user));
    BufStr<15> domain;
    EXPECT_FALSE(Sys::ParseUser("", user, domain));
}

TEST_F(UsersPosix, have_their_own_names) {
    passwd const* const own = getpwuid(geteuid());
    ASSERT_NE(own, nullptr);
    std::string const name = own->pw_name;
    BufStr<15> user;
    EXPECT_TRUE(Sys::CurrentUser(user, false));
    EXPECT_EQ(user.c_str(), name);
}

TEST_F(UsersPosix, have_no_default_logon_and_no_domain_cache) {
    BufStr<15> login("before");
    EXPECT_FALSE(Sys::DefaultLogin(login));
    EXPECT_STREQ(login.c_str(), "");
}

TEST_F(UsersPosix, Kept_sys_01_may_be_without_a_domain) {
    queryCalls.resolverDomain = resolve;
    BufStr<15> domain("before");
    resolvedDomain = nullptr;
    EXPECT_TRUE(Sys::CurrentDomain(domain, true));
    EXPECT_STREQ(domain.c_str(), "");
    EXPECT_FALSE(Sys::CurrentDomain(domain, false));
    EXPECT_STREQ(domain.c_str(), "");
    resolvedDomain = "";
    EXPECT_TRUE(Sys::CurrentDomain(domain, true));
    EXPECT_TRUE(Sys::CurrentDomain(domain, false));
    resolvedDomain = "Sales.Example.COM";
    EXPECT_TRUE(Sys::CurrentDomain(domain, true));
    EXPECT_STREQ(domain.c_str(), "sales.example.com");
    EXPECT_TRUE(Sys::CurrentDomain(domain, false));
    EXPECT_STREQ(domain.c_str(), "Sales.Example.COM");
}

TEST_F(UsersPosix, sit_at_the_machine_where_a_session_says_so) {
    struct Case {
        Row row;
        std::string sessions;
        char const* user;
    };
    std::string const longName(__UT_NAMESIZE, 'n');
    for (Case const& c : {
             Case{{}, "", "session"},
             Case{{}, recordsOf({{USER_PROCESS, "tty1", "jane"}}), "jane"},
             Case{{}, recordsOf({{USER_PROCESS, ":0", "jane"}}), "jane"},
             Case{{}, recordsOf({{USER_PROCESS, "pts/0", "remote"}}), "session"},
             Case{{}, recordsOf({{USER_PROCESS, "pts/0", "remote"}, {USER_PROCESS, "tty2", "jane"}}), "jane"},
             Case{{}, recordsOf({{USER_PROCESS, "tty2", "jane"}, {USER_PROCESS, "tty1", "john"}}), "jane"},
             Case{{}, recordsOf({{LOGIN_PROCESS, "tty1", "LOGIN"}, {DEAD_PROCESS, "tty2", "gone"}}), "session"},
             Case{{}, recordsOf({{BOOT_TIME, "~", "reboot"}}), "session"},
             Case{{}, recordsOf({{USER_PROCESS, "tty1", ""}}), "session"},
             Case{{}, recordsOf({{USER_PROCESS, "tty1", longName.c_str()}}), longName.c_str()},
             Case{{}, recordsOf({{USER_PROCESS, "tty1", "jane"}}).substr(0, sizeof(utmpx) - 1), "session"},
         }) {
        SCOPED_TRACE(c.row);
        Scratch const scratch;
        std::string const file = scratch / "sessions";
        put(file, c.sessions);
        queryCalls.sessions = file.c_str();
        queryCalls.userById = userById;
        queryCalls.effectiveUser = id1000;
        roomWanted = 0;
        BufStr<15> user("before");
        EXPECT_TRUE(Sys::CurHumanUser(user));
        EXPECT_STREQ(user.c_str(), c.user);
    }
}

TEST_F(UsersPosix, may_sit_nowhere) {
    queryCalls.sessions = "/no/such/file";
    queryCalls.userById = userById;
    queryCalls.effectiveUser = id4711;
    BufStr<15> user("before");
    EXPECT_FALSE(Sys::CurHumanUser(user));
    EXPECT_STREQ(user.c_str(), "");
}

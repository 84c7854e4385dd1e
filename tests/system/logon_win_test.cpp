// Logging on and acting as a user: what the system is asked for, and what the system at hand makes of it.

#include <zor_basis/system.h>

#include "basis/system/query_calls_win.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

namespace {

using Handle = std::unique_ptr<SysHdl>;
using Steps = std::vector<std::string>;

Steps steps;
HANDLE nextToken = nullptr;
BOOL admits = TRUE, acts = TRUE, reverts = TRUE;

std::string number(HANDLE handle) { return std::to_string(reinterpret_cast<std::int64_t>(handle)); }

BOOL WINAPI logonUser(char const* user, char const* domain, char const* password, DWORD kind, DWORD provider,
                      HANDLE* token) {
    steps.push_back(std::string("logon <") + user + "> " + (domain != nullptr ? domain : "null") + " " + password +
                    " " + std::to_string(kind) + " " + std::to_string(provider));
    *token = nextToken;
    return admits;
}
BOOL WINAPI impersonate(HANDLE token) {
    steps.push_back("act " + number(token));
    return acts;
}
BOOL WINAPI revert() {
    steps.push_back("revert");
    return reverts;
}
BOOL WINAPI closeHandle(HANDLE handle) {
    steps.push_back("close " + number(handle));
    return TRUE;
}

struct LogonWin : testing::Test {
    LogonWin() {
        steps.clear();
        nextToken = reinterpret_cast<HANDLE>(77);
        admits = acts = reverts = TRUE;
        queryCalls.logonUser = logonUser;
        queryCalls.impersonate = impersonate;
        queryCalls.revertToSelf = revert;
        queryCalls.closeHandle = closeHandle;
    }
    ~LogonWin() override { queryCalls = real; }

    QueryCalls const real = queryCalls;
};

/// A token with which the process can act as itself.
HANDLE ownToken() {
    HANDLE process = nullptr, token = nullptr;
    EXPECT_TRUE(OpenProcessToken(GetCurrentProcess(), TOKEN_DUPLICATE | TOKEN_QUERY, &process));
    EXPECT_TRUE(
        DuplicateTokenEx(process, TOKEN_ALL_ACCESS, nullptr, SecurityImpersonation, TokenImpersonation, &token));
    CloseHandle(process);
    return token;
}

bool threadActs() {
    HANDLE token = nullptr;
    bool const found = OpenThreadToken(GetCurrentThread(), TOKEN_QUERY, TRUE, &token) != FALSE;
    if (found) CloseHandle(token);
    return found;
}

} // namespace

TEST_F(LogonWin, asks_for_the_user_that_is_named) {
    struct Case {
        Row row;
        char const* user;
        bool interactive;
        char const* asked;
    };
    for (Case const& c : {
             Case{{}, "jane", true, "logon <jane> null secret 2 3"},
             Case{{}, "jane", false, "logon <jane> null secret 9 3"},
             Case{{}, "jane@SALES", true, "logon <jane> SALES secret 2 3"},
             Case{{}, "SALES\\jane", true, "logon <jane> SALES secret 2 3"},
             Case{{}, "SALES/jane", false, "logon <jane> SALES secret 9 3"},
             Case{{}, "jane@", true, "logon <jane>  secret 2 3"},
         }) {
        SCOPED_TRACE(c.row);
        steps.clear();
        Handle const handle(Sys::loginUser(c.user, "secret", c.interactive));
        ASSERT_NE(handle, nullptr);
        EXPECT_TRUE(handle->isValid());
        EXPECT_EQ(steps, (Steps{"revert", c.asked}));
    }
    steps.clear();
    Handle const part(Sys::loginUser(Str("jane doe", 4), Str("secret and more", 6), true));
    EXPECT_EQ(steps, (Steps{"revert", "logon <jane> null secret 2 3"}));
    steps.clear();
    Handle const open(Sys::loginUser("jane", "", true));
    EXPECT_EQ(steps, (Steps{"revert", "logon <jane> null  2 3"}));
}

TEST_F(LogonWin, gives_nothing_where_it_is_refused) {
    admits = FALSE;
    EXPECT_EQ(Sys::loginUser("jane", "wrong", true), nullptr);
    EXPECT_EQ(steps, (Steps{"revert", "logon <jane> null wrong 2 3"})) << "and closes nothing";
    steps.clear();
    EXPECT_EQ(Sys::loginUser("", "secret", true), nullptr);
    EXPECT_EQ(steps, Steps{}) << "an empty user is refused at once";
}

TEST_F(LogonWin, closes_the_token_with_its_handle) {
    delete Sys::loginUser("jane", "secret", true);
    EXPECT_EQ(steps.back(), "close 77");
    nextToken = nullptr;
    Handle zero(Sys::loginUser("jane", "secret", true));
    EXPECT_TRUE(zero->isValid()) << "a handle like any other";
    zero.reset();
    EXPECT_EQ(steps.back(), "close 0");
    nextToken = INVALID_HANDLE_VALUE;
    steps.clear();
    Handle none(Sys::loginUser("jane", "secret", true));
    EXPECT_FALSE(none->isValid());
    EXPECT_FALSE(Sys::impersonate(none.get()));
    none.reset();
    EXPECT_EQ(steps.size(), 3u) << "a logon and two reversions: there is nothing to act with and nothing to close";
}

TEST_F(LogonWin, lets_the_thread_act_as_one_user_at_a_time) {
    Handle const handle(Sys::loginUser("jane", "secret", true));
    steps.clear();
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    EXPECT_EQ(steps, (Steps{"revert", "act 77"}));
    steps.clear();
    EXPECT_TRUE(Sys::impersonate(nullptr));
    EXPECT_EQ(steps, Steps{"revert"});
    steps.clear();
    acts = FALSE;
    EXPECT_FALSE(Sys::impersonate(handle.get()));
    EXPECT_EQ(steps, (Steps{"revert", "act 77"}));
    steps.clear();
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_EQ(steps, Steps{"revert"});
    reverts = FALSE;
    EXPECT_FALSE(Sys::revertToSelf());
    EXPECT_TRUE(Sys::impersonate(nullptr)) << "whatever the system says";
}

TEST_F(LogonWin, really_acts_with_a_token_of_its_own) {
    queryCalls = real;
    queryCalls.logonUser = logonUser;
    nextToken = ownToken();
    Handle const handle(Sys::loginUser("jane", "secret", true));
    ASSERT_NE(handle, nullptr);
    EXPECT_FALSE(threadActs());
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    EXPECT_TRUE(threadActs());
    std::thread([] { EXPECT_FALSE(threadActs()) << "only the thread that asked"; }).join();
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    EXPECT_TRUE(threadActs());
    EXPECT_TRUE(Sys::impersonate(nullptr));
    EXPECT_FALSE(threadActs());
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_FALSE(threadActs());
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    EXPECT_EQ(Sys::loginUser("", "secret", true), nullptr);
    EXPECT_TRUE(threadActs()) << "an empty user changes nothing";
    nextToken = ownToken();
    Handle const again(Sys::loginUser("jane", "secret", true));
    EXPECT_FALSE(threadActs()) << "a logon is made as the process itself";
}

TEST_F(LogonWin, leaves_no_handle_behind_after_10000_times) {
    queryCalls = real;
    queryCalls.logonUser = logonUser;
    DWORD before = 0, after = 0;
    GetProcessHandleCount(GetCurrentProcess(), &before);
    for (int i = 0; i < 1000; ++i) {
        nextToken = ownToken();
        Handle const handle(Sys::loginUser("jane", "secret", true));
        for (int k = 0; k < 10; ++k) {
            ASSERT_TRUE(Sys::impersonate(handle.get()));
            ASSERT_TRUE(Sys::revertToSelf());
        }
    }
    GetProcessHandleCount(GetCurrentProcess(), &after);
    EXPECT_LE(after, before + 4);
    EXPECT_FALSE(threadActs());
}

TEST_F(LogonWin, really_refuses_to_act_with_a_token_that_is_none) {
    queryCalls = real;
    queryCalls.logonUser = logonUser;
    queryCalls.closeHandle = closeHandle;
    nextToken = reinterpret_cast<HANDLE>(0x7FFFFFF0);
    Handle const handle(Sys::loginUser("jane", "secret", true));
    EXPECT_FALSE(Sys::impersonate(handle.get()));
    EXPECT_FALSE(threadActs());
}

TEST_F(LogonWin, really_logs_on_or_refuses_cleanly) {
    // Wine admits everyone, with a token that nobody can act with; Windows does not know this user.
    queryCalls = real;
    Handle const handle(Sys::loginUser("zb_no_such_user", "secret", true));
    EXPECT_TRUE(handle == nullptr || handle->isValid());
    EXPECT_FALSE(handle != nullptr && Sys::impersonate(handle.get()));
    EXPECT_FALSE(threadActs());
    EXPECT_TRUE(Sys::revertToSelf());
}

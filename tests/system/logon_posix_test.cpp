// Logging on by PAM, with a configuration of the tests' own, and acting as another user on one thread.

#include <zor_basis/system.h>

#include "tests/support/scratch.h"
#include "tests/support/skip.h"
#include "tests/support/table.h"
#include "tests/system/query_calls_test_posix.h"

#include <grp.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <memory>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;
namespace fs = std::filesystem;

namespace {

using Handle = std::unique_ptr<SysHdl>;

constexpr char MATRIX[] = "/usr/lib/x86_64-linux-gnu/pam_wrapper/pam_matrix.so";

/// Where PAM finds its services now, and what it was asked for.
std::string configuration;
std::vector<std::string> asked;

int startConfigured(char const* service, char const* user, pam_conv const* conversation, pam_handle_t** handle) {
    asked.push_back(std::string(service) + " " + user);
    return pam_start_confdir(service, user, conversation, configuration.c_str(), handle);
}

int failToStart(char const*, char const*, pam_conv const*, pam_handle_t**) { return PAM_BUF_ERR; }

/// Changes of the thread's identity, in their order; the named one fails.
std::vector<std::string> changes;
std::string failing;
bool change(std::string const& what) {
    changes.push_back(what);
    return what != failing;
}
bool setGroups(std::size_t n, gid_t const*) { return change("groups " + std::to_string(n)); }
bool setGroup(gid_t group) { return change("group " + std::to_string(group)); }
bool setUser(uid_t user) { return change("user " + std::to_string(user)); }

uid_t user10() { return 10; }
gid_t group20() { return 20; }
int twoGroups(int n, gid_t* groups) {
    if (n >= 2) groups[0] = 30, groups[1] = 31;
    return 2;
}
int noGroups(int, gid_t*) { return -1; }

int threeGroups(char const*, gid_t group, gid_t* groups, int* n) {
    int const room = *n;
    *n = 3;
    if (room < 3) return -1;
    groups[0] = group, groups[1] = 50, groups[2] = 51;
    return 3;
}
/// A user of so many groups.
template <int MANY>
int manyGroups(char const*, gid_t group, gid_t* groups, int* n) {
    int const room = *n;
    *n = MANY;
    for (int i = 0; i < room && i < MANY; ++i) groups[i] = group;
    return room < MANY ? -1 : MANY;
}
int endlessGroups(char const*, gid_t, gid_t*, int*) { return -1; }

int jane(char const* name, passwd* record, char* buffer, std::size_t, passwd** found) {
    *found = nullptr;
    if (std::string(name) != "jane" && std::string(name) != "jane@SALES") return 0;
    *record = {};
    record->pw_name = buffer;
    std::snprintf(buffer, 20, "%s", name);
    record->pw_uid = 4001;
    record->pw_gid = 4002;
    *found = record;
    return 0;
}

struct LogonPosix : QueryCallsTest {
    LogonPosix() {
        asked.clear();
        changes.clear();
        failing.clear();
        configuration = scratch.path();
        queryCalls.pamStart = startConfigured;
        queryCalls.userByName = jane;
        queryCalls.groupsOf = threeGroups;
        admitWith("auth required pam_permit.so\naccount required pam_permit.so\n");
    }
    ~LogonPosix() override { Sys::revertToSelf(); }

    void admitWith(std::string const& rules) { put(scratch / "zor_basis", rules); }

    /// The thread's identity is one of the tests' own.
    static void pretend() {
        queryCalls.setGroups = setGroups;
        queryCalls.setEffectiveGroup = setGroup;
        queryCalls.setEffectiveUser = setUser;
        queryCalls.effectiveUser = user10;
        queryCalls.effectiveGroup = group20;
        queryCalls.groups = twoGroups;
    }

    Scratch const scratch;
};

using Changes = std::vector<std::string>;

} // namespace

TEST_F(LogonPosix, asks_pam_by_the_name_of_the_service) {
    Handle const first(Sys::loginUser("jane", "secret", true));
    ASSERT_NE(first, nullptr);
    EXPECT_TRUE(first->isValid());
    Handle const second(Sys::loginUser("jane@SALES", "secret", false));
    EXPECT_NE(second, nullptr);
    Handle const third(Sys::loginUser("SALES\\jane", "secret", false));
    EXPECT_NE(third, nullptr);
    Handle const fourth(Sys::loginUser(Str("jane doe", 4), Str("secret and more", 6), false));
    EXPECT_NE(fourth, nullptr);
    EXPECT_EQ(asked, (Changes{"zor_basis jane", "zor_basis jane@SALES", "zor_basis jane@SALES", "zor_basis jane"}));
}

TEST_F(LogonPosix, fails_where_pam_refuses) {
    admitWith("auth required pam_deny.so\naccount required pam_permit.so\n");
    EXPECT_EQ(Sys::loginUser("jane", "secret", true), nullptr);
    admitWith("auth required pam_permit.so\naccount required pam_deny.so\n");
    EXPECT_EQ(Sys::loginUser("jane", "secret", true), nullptr);
    put(scratch / "other", "auth required pam_deny.so\naccount required pam_deny.so\n");
    fs::remove(scratch / "zor_basis");
    EXPECT_EQ(Sys::loginUser("jane", "secret", true), nullptr) << "a machine that does not know the service";
    queryCalls.pamStart = failToStart;
    EXPECT_EQ(Sys::loginUser("jane", "secret", true), nullptr);
}

TEST_F(LogonPosix, fails_for_users_without_an_account) {
    EXPECT_EQ(Sys::loginUser("john", "secret", true), nullptr);
    queryCalls.groupsOf = endlessGroups;
    EXPECT_EQ(Sys::loginUser("jane", "secret", true), nullptr) << "whose groups are unknown";
    queryCalls.groupsOf = manyGroups<65537>;
    EXPECT_EQ(Sys::loginUser("jane", "secret", true), nullptr) << "whose groups are more than the kernel keeps";
}

TEST_F(LogonPosix, takes_as_many_groups_as_the_kernel_keeps) {
    struct Case {
        Row row;
        int (*groupsOf)(char const*, gid_t, gid_t*, int*);
        char const* change;
    };
    for (Case const& c : {
             Case{{}, manyGroups<16>, "groups 16"},
             Case{{}, manyGroups<17>, "groups 17"},
             Case{{}, manyGroups<5000>, "groups 5000"},
             Case{{}, manyGroups<16384>, "groups 16384"},
             Case{{}, manyGroups<16385>, "groups 16385"},
             Case{{}, manyGroups<65536>, "groups 65536"},
         }) {
        SCOPED_TRACE(c.row);
        changes.clear();
        queryCalls.groupsOf = c.groupsOf;
        Handle const handle(Sys::loginUser("jane", "secret", true));
        ASSERT_NE(handle, nullptr);
        pretend();
        EXPECT_TRUE(Sys::impersonate(handle.get()));
        EXPECT_EQ(changes.front(), c.change);
        Sys::revertToSelf();
    }
}

TEST_F(LogonPosix, hands_the_password_to_the_modules) {
    if (!fs::exists(MATRIX)) CASE_CANNOT_HOLD("libpam-wrapper is not installed");
    put(scratch / "passwords", "jane:secret:zor_basis\njohn:secret:other\n");
    std::string const module = std::string(" required ") + MATRIX + " passdb=" + (scratch / "passwords");
    admitWith("auth" + module + "\naccount" + module + "\n");
    Handle const handle(Sys::loginUser("jane", "secret", true));
    EXPECT_NE(handle, nullptr);
    Handle const part(Sys::loginUser("jane", Str("secret and more", 6), true));
    EXPECT_NE(part, nullptr);
    for (char const* wrong : {"", "Secret", "secret ", "secre"})
        EXPECT_EQ(Sys::loginUser("jane", wrong, true), nullptr) << wrong;
    EXPECT_EQ(Sys::loginUser("jim", "secret", true), nullptr);

    admitWith("auth" + module + " verbose\naccount" + module + " verbose\n");
    Handle const told(Sys::loginUser("jane", "secret", true));
    EXPECT_NE(told, nullptr) << "messages are no questions";
    admitWith("auth" + module + " echo\naccount" + module + "\n");
    EXPECT_EQ(Sys::loginUser("jane", "secret", true), nullptr) << "the password is shown to nobody";
}

TEST_F(LogonPosix, changes_the_user_last_and_back_first) {
    pretend();
    Handle const handle(Sys::loginUser("jane", "secret", true));
    ASSERT_NE(handle, nullptr);
    EXPECT_EQ(changes, Changes{}) << "the thread was itself";
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    EXPECT_EQ(changes, (Changes{"groups 3", "group 4002", "user 4001"}));
    changes.clear();
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_EQ(changes, (Changes{"user 10", "group 20", "groups 2"}));
    changes.clear();
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_EQ(changes, Changes{}) << "it was itself";
}

TEST_F(LogonPosix, acts_as_one_user_at_a_time) {
    pretend();
    Handle const handle(Sys::loginUser("jane", "secret", true));
    Changes const there{"groups 3", "group 4002", "user 4001"};
    Changes const back{"user 10", "group 20", "groups 2"};
    Changes backAndThere = back;
    backAndThere.insert(backAndThere.end(), there.begin(), there.end());

    EXPECT_TRUE(Sys::impersonate(handle.get()));
    changes.clear();
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    EXPECT_EQ(changes, backAndThere);
    changes.clear();
    EXPECT_TRUE(Sys::impersonate(nullptr));
    EXPECT_EQ(changes, back);

    EXPECT_TRUE(Sys::impersonate(handle.get()));
    changes.clear();
    EXPECT_EQ(Sys::loginUser("", "secret", true), nullptr);
    EXPECT_EQ(changes, Changes{}) << "an empty user changes nothing";
    Handle const again(Sys::loginUser("jane", "secret", true));
    EXPECT_EQ(changes, back) << "a logon is made as the process itself";
    changes.clear();
    EXPECT_TRUE(Sys::impersonate(handle.get()));
    changes.clear();
    EXPECT_EQ(Sys::loginUser("john", "secret", true), nullptr);
    EXPECT_EQ(changes, back) << "whatever becomes of it";
}

TEST_F(LogonPosix, leaves_the_thread_as_it_was_where_a_change_fails) {
    pretend();
    Handle const handle(Sys::loginUser("jane", "secret", true));
    failing = "groups 3";
    EXPECT_FALSE(Sys::impersonate(handle.get()));
    EXPECT_EQ(changes, Changes{"groups 3"});
    changes.clear();
    failing = "group 4002";
    EXPECT_FALSE(Sys::impersonate(handle.get()));
    EXPECT_EQ(changes, (Changes{"groups 3", "group 4002", "groups 2"}));
    changes.clear();
    failing = "user 4001";
    EXPECT_FALSE(Sys::impersonate(handle.get()));
    EXPECT_EQ(changes, (Changes{"groups 3", "group 4002", "user 4001", "group 20", "groups 2"}));
    changes.clear();
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_EQ(changes, Changes{});
    queryCalls.groups = noGroups;
    EXPECT_FALSE(Sys::impersonate(handle.get())) << "there would be no way back";
    EXPECT_EQ(changes, Changes{});
}

TEST_F(LogonPosix, stays_where_the_way_back_fails_and_can_try_again) {
    pretend();
    Handle const handle(Sys::loginUser("jane", "secret", true));
    for (char const* step : {"user 10", "group 20", "groups 2"}) {
        ASSERT_TRUE(Sys::impersonate(handle.get()));
        failing = step;
        EXPECT_FALSE(Sys::revertToSelf()) << step;
        EXPECT_FALSE(Sys::impersonate(nullptr)) << step;
        EXPECT_FALSE(Sys::impersonate(handle.get())) << step;
        failing.clear();
        changes.clear();
        EXPECT_TRUE(Sys::revertToSelf()) << step;
        EXPECT_EQ(changes, (Changes{"user 10", "group 20", "groups 2"}));
    }
}

TEST_F(LogonPosix, is_a_matter_of_one_thread) {
    pretend();
    Handle const handle(Sys::loginUser("jane", "secret", true));
    ASSERT_TRUE(Sys::impersonate(handle.get()));
    changes.clear();
    std::thread([] { EXPECT_TRUE(Sys::revertToSelf()); }).join();
    EXPECT_EQ(changes, Changes{}) << "the other thread was itself";
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_EQ(changes.size(), 3u);
}

TEST_F(LogonPosix, really_acts_as_nobody_while_another_thread_stays_root) {
    if (geteuid() != 0) CASE_CANNOT_HOLD("only root may act as others");
    queryCalls.userByName = real.userByName;
    queryCalls.groupsOf = real.groupsOf;
    fs::permissions(scratch.path(), fs::perms::all);
    Handle const handle(Sys::loginUser("nobody", "secret", true));
    ASSERT_NE(handle, nullptr);
    uid_t const nobody = getpwnam("nobody")->pw_uid;
    gid_t const nogroup = getpwnam("nobody")->pw_gid;
    put(scratch / "roots", "for root only");
    fs::permissions(scratch / "roots", fs::perms::owner_read);
    std::thread([&] {
        ASSERT_TRUE(Sys::impersonate(handle.get()));
        EXPECT_EQ(geteuid(), nobody);
        EXPECT_EQ(getegid(), nogroup);
        BufStr<15> user;
        EXPECT_TRUE(Sys::CurrentUser(user, false));
        EXPECT_STREQ(user.c_str(), "nobody");
        EXPECT_TRUE(Sys::CurrentUser(user, true));
        EXPECT_STRNE(user.c_str(), "nobody") << "the session is still the process's";
        put(scratch / "nobodys", "made by nobody");
        EXPECT_EQ(textOf(scratch / "roots"), "") << "nobody may not read that";
        std::thread inherits([&] { EXPECT_EQ(geteuid(), nobody); });
        inherits.join();
        EXPECT_TRUE(Sys::revertToSelf());
        EXPECT_EQ(geteuid(), 0u);
        EXPECT_EQ(textOf(scratch / "roots"), "for root only");
    }).join();
    EXPECT_EQ(geteuid(), 0u) << "of the thread that looked on";
    struct stat status;
    ASSERT_EQ(stat((scratch / "nobodys").c_str(), &status), 0);
    EXPECT_EQ(status.st_uid, nobody);
    EXPECT_EQ(status.st_gid, nogroup);
}

TEST_F(LogonPosix, really_fails_without_privilege) {
    if (geteuid() != 0) CASE_CANNOT_HOLD("only root can give its privilege up");
    queryCalls.userByName = real.userByName;
    queryCalls.groupsOf = real.groupsOf;
    Handle const nobody(Sys::loginUser("nobody", "secret", true));
    Handle const root(Sys::loginUser("root", "secret", true));
    ASSERT_NE(nobody, nullptr);
    ASSERT_NE(root, nullptr);
    std::thread([&] {
        ASSERT_TRUE(Sys::impersonate(nobody.get()));
        std::thread([&] {
            // This thread has been nobody from the start.
            uid_t const before = geteuid();
            EXPECT_FALSE(Sys::impersonate(root.get()));
            EXPECT_EQ(geteuid(), before);
            EXPECT_TRUE(Sys::revertToSelf());
            EXPECT_TRUE(Sys::impersonate(nullptr));
        }).join();
        EXPECT_TRUE(Sys::revertToSelf());
    }).join();
}

TEST_F(LogonPosix, leaves_nothing_behind_after_10000_times) {
    if (geteuid() != 0) CASE_CANNOT_HOLD("only root may act as others");
    queryCalls.userByName = real.userByName;
    queryCalls.groupsOf = real.groupsOf;
    std::vector<gid_t> groups(100);
    groups.resize(static_cast<std::size_t>(getgroups(100, groups.data())));
    Handle const handle(Sys::loginUser("nobody", "secret", true));
    ASSERT_NE(handle, nullptr);
    for (int i = 0; i < 10'000; ++i) {
        ASSERT_TRUE(Sys::impersonate(handle.get()));
        ASSERT_TRUE(i % 2 == 0 ? Sys::revertToSelf() : Sys::impersonate(nullptr));
    }
    EXPECT_EQ(geteuid(), 0u);
    EXPECT_EQ(getegid(), real.effectiveGroup());
    std::vector<gid_t> after(100);
    after.resize(static_cast<std::size_t>(getgroups(100, after.data())));
    EXPECT_EQ(after, groups);
    auto const open = [] { return std::distance(fs::directory_iterator("/proc/self/fd"), fs::directory_iterator()); };
    auto const before = open();
    for (int i = 0; i < 200; ++i) Handle(Sys::loginUser("nobody", "secret", true));
    EXPECT_EQ(open(), before);
}

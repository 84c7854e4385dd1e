// Profiles, in the registry itself.

#include <zor_basis/system.h>

#include "basis/system/profiles_win.h"
#include "tests/support/table.h"
#include "tests/system/registry_scratch_win.h"
#include "tests/system/system_says_win.h"
#include "tests/system/wanted_room_win.h"

#include <cstring>
#include <set>

using namespace ZOR_Basis;

namespace {

using Found = std::vector<std::pair<std::string, std::string>>;

/// All profiles of sessions that are the tests' own.
Found ownProfiles() {
    Found found;
    Profile profile;
    for (unsigned n = 0; profileOfSession(n, profile); ++n) {
        if (std::strncmp(profile.key, "zb_", 3) == 0) found.push_back({profile.key.c_str(), profile.user.c_str()});
    }
    EXPECT_STREQ(profile.key.c_str(), "");
    EXPECT_STREQ(profile.user.c_str(), "");
    return found;
}

std::string explorerOf(std::string const& profile) { return profile + "\\" + EXPLORER; }
std::string sessionOf(std::string const& profile) { return profile + "\\" + VOLATILE; }

struct ProfilesWin : RegistryScratch {
    ProfilesWin() {
        // Whoever runs the tests has no session in them.
        removeValue(HKEY_CURRENT_USER, EXPLORER, "Logon User Name");
        queryCalls.userName = userName;
        queryCalls.computerName = computerName;
        threadUser = "thread";
        computerNames = {{ComputerNameNetBIOS, "PRINTER1"}};
    }
    void makeProfile(std::string const& name, std::string const& user) {
        makeKey(HKEY_USERS, sessionOf(name));
        set(HKEY_USERS, explorerOf(name), "Logon User Name", user);
    }
    std::string humanUser(bool expected = true) {
        BufStr<15> user("before");
        EXPECT_EQ(Sys::CurHumanUser(user), expected);
        return user.c_str();
    }
};

/// A list of subkeys whose names want more room than there is.
DWORD keyRoomWanted = 0;
LSTATUS WINAPI enumKey(HKEY parent, DWORD index, char* name, DWORD* n, DWORD* a, char* b, DWORD* c, FILETIME* d) {
    rooms.push_back({index, *n});
    if (*n < keyRoomWanted) {
        if (reports) *n = keyRoomWanted;
        return ERROR_MORE_DATA;
    }
    return realCalls.enumKey(parent, index, name, n, a, b, c, d);
}

} // namespace

TEST_F(ProfilesWin, count_with_a_session_and_a_logon_name) {
    EXPECT_EQ(ownProfiles(), Found{});
    makeProfile("zb_a", "jane");
    makeKey(HKEY_USERS, "zb_b");
    set(HKEY_USERS, explorerOf("zb_c"), "Logon User Name", "no session");
    makeKey(HKEY_USERS, sessionOf("zb_d"));
    makeKey(HKEY_USERS, sessionOf("zb_e"));
    makeKey(HKEY_USERS, explorerOf("zb_e"));
    makeProfile("zb_f", "");
    makeProfile("zb_g", "john");
    makeProfile("zb_h", std::string(700, 'u')); // beyond the first buffer
    EXPECT_EQ(ownProfiles(),
              (Found{{"zb_a", "jane"}, {"zb_f", ""}, {"zb_g", "john"}, {"zb_h", std::string(700, 'u')}}));
}

TEST_F(ProfilesWin, may_have_long_keys) {
    std::string const name = "zb_" + std::string(190, 'k');
    makeProfile(name, "jane");
    EXPECT_EQ(ownProfiles(), (Found{{name, "jane"}}));
}

TEST_F(ProfilesWin, are_read_again_with_more_room) {
    makeProfile("zb_a", "jane");
    queryCalls.enumKey = enumKey;
    reports = true;
    keyRoomWanted = 5000;
    rooms.clear();
    EXPECT_EQ(ownProfiles(), (Found{{"zb_a", "jane"}}));
    EXPECT_EQ(rooms[0], (std::pair<DWORD, DWORD>(0, 512)));
    EXPECT_EQ(rooms[1], (std::pair<DWORD, DWORD>(0, 5000))) << "the same index again";
    reports = false;
    EXPECT_EQ(ownProfiles(), (Found{{"zb_a", "jane"}}));
    keyRoomWanted = ~DWORD{0};
    EXPECT_EQ(ownProfiles(), Found{}) << "never enough";
}

TEST_F(ProfilesWin, tell_who_sits_at_the_machine) {
    EXPECT_EQ(humanUser(), "thread") << "nobody has a session";
    makeProfile("zb_b", "jane");
    EXPECT_EQ(humanUser(), "jane");
    makeProfile("zb_a", "");
    EXPECT_EQ(humanUser(), "jane") << "an empty name is nobody's";
    makeProfile("zb_c", "john");
    EXPECT_EQ(humanUser(), "jane") << "the first one";
}

TEST_F(ProfilesWin, are_all_there_is_for_accounts_of_the_machine) {
    for (char const* account : {"SYSTEM", "System", "PRINTER1$", "printer1$"}) {
        threadUser = account;
        EXPECT_EQ(humanUser(false), "") << account;
    }
    for (char const* account : {"PRINTER1", "PRINTER2$", "SYSTEMS"}) {
        threadUser = account;
        EXPECT_EQ(humanUser(), account);
    }
    threadUser = "";
    EXPECT_EQ(humanUser(false), "");
    threadUser = nullptr;
    EXPECT_EQ(humanUser(false), "");
    threadUser = "PRINTER1$";
    computerNames.clear();
    EXPECT_EQ(humanUser(), "PRINTER1$") << "the computer has no name";
    threadUser = "SYSTEM";
    makeProfile("zb_a", "jane");
    EXPECT_EQ(humanUser(), "jane");
}

TEST_F(ProfilesWin, belong_to_the_domains_that_they_name) {
    constexpr char STATE[] = "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\Group Policy\\State\\zb_a";
    Profile profile{"zb_a", "jane"};
    makeProfile("zb_a", "jane");
    EXPECT_TRUE(isOfDomain(profile, "SALES")) << "it names none";
    set(HKEY_LOCAL_MACHINE, STATE, "Distinguished-Name", "CN=Jane,DC=sales,DC=example");
    EXPECT_TRUE(isOfDomain(profile, "SALES.example"));
    EXPECT_FALSE(isOfDomain(profile, "SALES"));
    set(HKEY_USERS, sessionOf("zb_a"), "USERDOMAIN", "SALES");
    EXPECT_TRUE(isOfDomain(profile, "sales"));
    EXPECT_FALSE(isOfDomain(profile, "sales.example")) << "the session goes first";
    set(HKEY_USERS, sessionOf("zb_a"), "USERDNSDOMAIN", "SALES.EXAMPLE");
    EXPECT_TRUE(isOfDomain(profile, "sales"));
    EXPECT_TRUE(isOfDomain(profile, "sales.example"));
    EXPECT_FALSE(isOfDomain(profile, "print"));
    set(HKEY_USERS, sessionOf("zb_a"), "USERDOMAIN", "");
    EXPECT_FALSE(isOfDomain(profile, ""));
}

TEST_F(ProfilesWin, are_closed_10000_times) {
    makeProfile("zb_a", "jane");
    set(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "SALES", "sales.example");
    DWORD before = 0, after = 0;
    GetProcessHandleCount(GetCurrentProcess(), &before);
    for (int i = 0; i < 2'000; ++i) {
        BufStr<15> text;
        BufStr<255> domain;
        ASSERT_TRUE(Sys::CurHumanUser(text));
        ASSERT_TRUE(Sys::CurrentDomain(text, true));
        Sys::CurrentUser(text, true);
        Sys::DefaultLogin(text);
        ASSERT_TRUE(Sys::FullDomain("SALES", domain));
    }
    GetProcessHandleCount(GetCurrentProcess(), &after);
    EXPECT_GE(keysOpened, 10'000);
    EXPECT_EQ(keysOpened, keysClosed);
    EXPECT_LE(after, before + 4);
}

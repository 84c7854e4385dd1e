// Users and their domains, in the registry itself.

#include <zor_basis/system.h>

#include "tests/support/table.h"
#include "tests/system/registry_scratch_win.h"
#include "tests/system/system_says_win.h"

using namespace ZOR_Basis;

namespace {

struct UsersOfTheRegistryWin : RegistryScratch {};
struct DomainsOfTheRegistryWin : RegistryScratch {};

std::string currentUser(bool& known) {
    BufStr<15> user("before");
    known = Sys::CurrentUser(user, true);
    return user.c_str();
}

} // namespace

TEST_F(UsersOfTheRegistryWin, are_named_by_the_session) {
    struct Case {
        Row row;
        std::string text; // as stored
        DWORD type;
        bool known;
        std::string user;
    };
    std::string const nul(1, '\0');
    for (Case const& c : {
             Case{{}, "jane" + nul, REG_SZ, true, "jane"},
             Case{{}, "a user of more than 15 bytes" + nul, REG_SZ, true, "a user of more than 15 bytes"},
             Case{{}, nul, REG_SZ, true, ""},
             Case{{}, "", REG_SZ, true, ""},
             Case{{}, "jane", REG_SZ, true, "jane"}, // without a terminator
             Case{{}, "jane" + nul + "rest" + nul, REG_SZ, true, "jane"},
             Case{{}, "jane" + nul + nul + nul, REG_SZ, true, "jane"},
             Case{{}, "%jane%" + nul, REG_EXPAND_SZ, true, "%jane%"}, // as it stands
             Case{{}, "jane" + nul + "john" + nul + nul, REG_MULTI_SZ, true, "jane"},
             Case{{}, std::string(511, 'j') + nul, REG_SZ, true, std::string(511, 'j')},
             Case{{}, std::string(512, 'j') + nul, REG_SZ, false, ""},
             Case{{}, std::string(5000, 'j') + nul, REG_SZ, false, ""},
             Case{{}, "ja", REG_DWORD, false, ""},
             Case{{}, "jane" + nul, REG_BINARY, false, ""},
             Case{{}, "jane" + nul, REG_NONE, false, ""},
         }) {
        SCOPED_TRACE(c.row);
        setRaw(HKEY_CURRENT_USER, EXPLORER, "Logon User Name", c.text, c.type);
        bool known = false;
        EXPECT_EQ(currentUser(known), c.user);
        EXPECT_EQ(known, c.known);
    }
}

TEST_F(UsersOfTheRegistryWin, may_be_stored_in_an_odd_number_of_bytes) {
    setBytes(HKEY_CURRENT_USER, EXPLORER, "Logon User Name", REG_SZ, std::string("j\0a\0n\0e\0x", 9));
    bool known = false;
    EXPECT_EQ(currentUser(known).substr(0, 4), "jane");
    EXPECT_TRUE(known);
    setBytes(HKEY_CURRENT_USER, EXPLORER, "Logon User Name", REG_SZ, "x");
    currentUser(known);
    EXPECT_TRUE(known);
}

TEST_F(UsersOfTheRegistryWin, may_be_unknown) {
    removeValue(HKEY_CURRENT_USER, EXPLORER, "Logon User Name");
    bool known = true;
    EXPECT_EQ(currentUser(known), "");
    EXPECT_FALSE(known);
}

TEST_F(UsersOfTheRegistryWin, of_the_thread_are_what_the_system_says) {
    BufStr<15> user("before");
    char expected[256];
    DWORD n = sizeof expected;
    ASSERT_TRUE(GetUserNameA(expected, &n));
    EXPECT_TRUE(Sys::CurrentUser(user, false));
    EXPECT_STREQ(user.c_str(), expected);
    queryCalls.userName = userName;
    threadUser = "a user of more than 15 bytes";
    EXPECT_TRUE(Sys::CurrentUser(user, false));
    EXPECT_STREQ(user.c_str(), threadUser);
    threadUser = nullptr;
    EXPECT_FALSE(Sys::CurrentUser(user, false));
    EXPECT_STREQ(user.c_str(), "");
}

TEST_F(UsersOfTheRegistryWin, Kept_sys_02_are_logged_on_by_default_with_a_domain_that_may_be_empty) {
    BufStr<15> login("before");
    set(HKEY_LOCAL_MACHINE, WINLOGON, "DefaultUserName", "jane");
    set(HKEY_LOCAL_MACHINE, WINLOGON, "DefaultDomainName", "SALES");
    EXPECT_TRUE(Sys::DefaultLogin(login));
    EXPECT_STREQ(login.c_str(), "jane@SALES");
    set(HKEY_LOCAL_MACHINE, WINLOGON, "DefaultDomainName", "");
    EXPECT_TRUE(Sys::DefaultLogin(login));
    EXPECT_STREQ(login.c_str(), "jane@");
    removeValue(HKEY_LOCAL_MACHINE, WINLOGON, "DefaultDomainName");
    EXPECT_TRUE(Sys::DefaultLogin(login));
    EXPECT_STREQ(login.c_str(), "jane");
    set(HKEY_LOCAL_MACHINE, WINLOGON, "DefaultDomainName", "SALES");
    removeValue(HKEY_LOCAL_MACHINE, WINLOGON, "DefaultUserName");
    EXPECT_FALSE(Sys::DefaultLogin(login));
    EXPECT_STREQ(login.c_str(), "");
}

TEST_F(DomainsOfTheRegistryWin, Kept_sys_01_may_be_missing) {
    BufStr<15> domain("before");
    set(HKEY_CURRENT_USER, VOLATILE, "USERDNSDOMAIN", "SALES.Example.COM");
    EXPECT_TRUE(Sys::CurrentDomain(domain, true));
    EXPECT_STREQ(domain.c_str(), "sales.example.com");
    set(HKEY_CURRENT_USER, VOLATILE, "USERDNSDOMAIN", "SALES");
    EXPECT_TRUE(Sys::CurrentDomain(domain, true));
    EXPECT_STREQ(domain.c_str(), "sales");
    removeValue(HKEY_CURRENT_USER, VOLATILE, "USERDNSDOMAIN");
    EXPECT_TRUE(Sys::CurrentDomain(domain, true));
    EXPECT_STREQ(domain.c_str(), "");
    domain = "before";
    queryCalls.openKey = [](HKEY, char const*, DWORD, REGSAM, HKEY*) -> LSTATUS { return ERROR_FILE_NOT_FOUND; };
    EXPECT_TRUE(Sys::CurrentDomain(domain, true));
    EXPECT_STREQ(domain.c_str(), "");
}

TEST_F(DomainsOfTheRegistryWin, of_the_computer_are_what_the_system_says) {
    BufStr<15> domain("before");
    EXPECT_TRUE(Sys::CurrentDomain(domain, false));
    queryCalls.computerName = computerName;
    computerNames = {{ComputerNameDnsDomain, "Sales.Example.COM"}};
    EXPECT_TRUE(Sys::CurrentDomain(domain, false));
    EXPECT_STREQ(domain.c_str(), "Sales.Example.COM") << "in its own letters";
    computerNames = {{ComputerNameDnsDomain, ""}};
    EXPECT_TRUE(Sys::CurrentDomain(domain, false));
    EXPECT_STREQ(domain.c_str(), "");
    computerNames.clear();
    domain = "before";
    EXPECT_FALSE(Sys::CurrentDomain(domain, false));
    EXPECT_STREQ(domain.c_str(), "");
}

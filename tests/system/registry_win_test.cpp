// Users, domains and profiles, in the registry itself.

#include <zor_basis/system.h>

#include "basis/system/profiles_win.h"
#include "tests/support/table.h"
#include "tests/system/registry_scratch_win.h"

#include <cstring>
#include <map>
#include <set>

using namespace ZOR_Basis;

namespace {

using RegistryUsers = RegistryTest;
using RegistryDomains = RegistryTest;
using RegistryProfiles = RegistryTest;

/// What the system says of the thread's user and of the computer; null makes the call fail.
char const* threadUser = nullptr;
std::map<int, char const*> computerNames;

BOOL give(char const* text, char* buffer, DWORD* n) {
    if (text == nullptr) return FALSE;
    std::size_t const length = std::strlen(text);
    if (*n <= length) {
        *n = static_cast<DWORD>(length + 1);
        SetLastError(ERROR_MORE_DATA);
        return FALSE;
    }
    std::strcpy(buffer, text);
    *n = static_cast<DWORD>(length);
    return TRUE;
}
BOOL WINAPI userName(char* buffer, DWORD* n) { return give(threadUser, buffer, n); }
BOOL WINAPI computerName(COMPUTER_NAME_FORMAT format, char* buffer, DWORD* n) {
    return give(computerNames[format], buffer, n);
}

std::string currentUser(bool& known) {
    BufStr<15> user("before");
    known = Sys::CurrentUser(user, true);
    return user.c_str();
}

} // namespace

TEST_F(RegistryUsers, are_named_by_the_session) {
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

TEST_F(RegistryUsers, may_be_stored_in_an_odd_number_of_bytes) {
    setBytes(HKEY_CURRENT_USER, EXPLORER, "Logon User Name", REG_SZ, std::string("j\0a\0n\0e\0x", 9));
    bool known = false;
    EXPECT_EQ(currentUser(known).substr(0, 4), "jane");
    EXPECT_TRUE(known);
    setBytes(HKEY_CURRENT_USER, EXPLORER, "Logon User Name", REG_SZ, "x");
    currentUser(known);
    EXPECT_TRUE(known);
}

TEST_F(RegistryUsers, may_be_unknown) {
    removeValue(HKEY_CURRENT_USER, EXPLORER, "Logon User Name");
    bool known = true;
    EXPECT_EQ(currentUser(known), "");
    EXPECT_FALSE(known);
}

TEST_F(RegistryUsers, of_the_thread_are_what_the_system_says) {
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

TEST_F(RegistryDomains, Kept_sys_01_may_be_missing) {
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

TEST_F(RegistryDomains, of_the_computer_are_what_the_system_says) {
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

TEST_F(RegistryUsers, Kept_sys_02_are_logged_on_by_default_with_a_domain_that_may_be_empty) {
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

namespace {

/// A cache with names of every length.
struct DomainCache : RegistryTest {
    DomainCache() {
        for (auto const& [shortName, fullName] : names) set(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, shortName, fullName);
    }

    std::vector<std::pair<std::string, std::string>> const names = {
        {"SALES", "sales.example.com"},
        {"PRINT", "print.example.com"},
        {"NAMELESS", ""},
        {std::string(511, 'S'), std::string(511, 'f')},
        {std::string(512, 'S'), std::string(512, 'f')},
        {std::string(513, 'S'), std::string(20, 'f')},
        {std::string(2000, 'S'), std::string(3000, 'f')},
        {"LONG", std::string(10'000, 'l')},
        {"LAST", "last.example.com"},
    };
};

} // namespace

TEST_F(DomainCache, translates_both_ways) {
    for (auto const& [shortName, fullName] : names) {
        BufStr<255> domain("before");
        EXPECT_TRUE(Sys::FullDomain(shortName, domain)) << shortName;
        EXPECT_EQ(domain.c_str(), fullName);
        domain = "before";
        EXPECT_TRUE(Sys::ShortDomain(fullName, domain)) << fullName;
        EXPECT_EQ(domain.c_str(), shortName);
    }
    EXPECT_EQ(keysOpened, 18);
}

TEST_F(DomainCache, Kept_sys_04_compares_every_byte) {
    BufStr<255> domain("before");
    for (char const* name : {"sales", "SALE", "SALES ", "SALESX", "Sales", "sales.example.com", "no such"})
        EXPECT_FALSE(Sys::FullDomain(name, domain)) << name;
    for (char const* name : {"SALES.EXAMPLE.COM", "sales.example.co", "sales.example.com.", "SALES"})
        EXPECT_FALSE(Sys::ShortDomain(name, domain)) << name;
    EXPECT_STREQ(domain.c_str(), "before");
    EXPECT_TRUE(Sys::FullDomain(Str("SALES and more", 5), domain)) << "a view ends where it ends";
    EXPECT_FALSE(Sys::FullDomain(Str("SALES", 4), domain));
}

TEST_F(DomainCache, may_hold_what_is_no_text) {
    setRaw(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "BINARY", "text", REG_BINARY);
    setRaw(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "NUMBER", "ab", REG_DWORD);
    setRaw(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "OPEN", "open.example.com"); // without a terminator
    setBytes(HKEY_LOCAL_MACHINE, DOMAIN_CACHE, "NOTHING", REG_SZ, "");
    BufStr<255> domain("before");
    EXPECT_FALSE(Sys::FullDomain("BINARY", domain));
    EXPECT_FALSE(Sys::FullDomain("NUMBER", domain));
    EXPECT_STREQ(domain.c_str(), "before");
    EXPECT_TRUE(Sys::FullDomain("OPEN", domain));
    EXPECT_STREQ(domain.c_str(), "open.example.com");
    EXPECT_TRUE(Sys::ShortDomain("open.example.com", domain));
    EXPECT_STREQ(domain.c_str(), "OPEN");
    EXPECT_TRUE(Sys::FullDomain("NOTHING", domain));
    EXPECT_STREQ(domain.c_str(), "");
    EXPECT_TRUE(Sys::FullDomain("LAST", domain)) << "what is no text ends nothing";
}

TEST_F(RegistryDomains, are_not_translated_without_a_cache) {
    BufStr<255> domain("before");
    queryCalls.openKey = [](HKEY, char const* path, DWORD, REGSAM, HKEY*) -> LSTATUS {
        EXPECT_STREQ(path, DOMAIN_CACHE);
        return ERROR_FILE_NOT_FOUND;
    };
    EXPECT_FALSE(Sys::FullDomain("SALES", domain));
    EXPECT_FALSE(Sys::ShortDomain("sales.example.com", domain));
    EXPECT_STREQ(domain.c_str(), "before");
}

namespace {

/// A cache of one value, which wants more room than it says.
DWORD nameWanted, dataWanted;
bool reports;
int enumerations;
std::vector<std::pair<DWORD, DWORD>> rooms;

LSTATUS WINAPI enumValue(HKEY, DWORD index, char* name, DWORD* nameLength, DWORD*, DWORD* type, BYTE* data,
                         DWORD* dataLength) {
    ++enumerations;
    if (index != 0) return ERROR_NO_MORE_ITEMS;
    rooms.push_back({*nameLength, *dataLength});
    if (*nameLength < nameWanted || *dataLength < dataWanted) {
        if (reports) {
            *nameLength = nameWanted;
            *dataLength = dataWanted;
        }
        return ERROR_MORE_DATA;
    }
    *type = REG_SZ;
    std::memset(name, 'n', *nameLength);
    std::memcpy(name, "SALES", 6);
    *nameLength = 5;
    std::memset(data, 'd', *dataLength); // and no terminator
    std::memcpy(data, "sales.example", 13);
    *dataLength = 13;
    return ERROR_SUCCESS;
}

} // namespace

TEST_F(RegistryDomains, are_read_again_with_more_room_until_they_fit) {
    makeKey(HKEY_LOCAL_MACHINE, DOMAIN_CACHE);
    queryCalls.enumValue = enumValue;
    struct Case {
        Row row;
        bool reports;
        DWORD name, data;
        std::vector<std::pair<DWORD, DWORD>> rooms;
    };
    for (Case const& c : {
             Case{{}, true, 6, 100, {{512, 512}}},
             Case{{}, true, 6, 513, {{512, 512}, {512, 513}}},
             Case{{}, true, 700, 100, {{512, 512}, {700, 512}}},
             Case{{}, true, 700, 9000, {{512, 512}, {700, 9000}}},
             Case{{}, false, 700, 100, {{512, 512}, {1024, 1024}}},
             Case{{}, false, 6, 3000, {{512, 512}, {1024, 1024}, {2048, 2048}, {4096, 4096}}},
         }) {
        SCOPED_TRACE(c.row);
        reports = c.reports;
        nameWanted = c.name;
        dataWanted = c.data;
        rooms.clear();
        BufStr<255> domain;
        EXPECT_TRUE(Sys::FullDomain("SALES", domain));
        EXPECT_STREQ(domain.c_str(), "sales.example");
        EXPECT_EQ(rooms, c.rooms);
    }
}

TEST_F(RegistryDomains, are_given_up_where_no_room_is_ever_enough) {
    makeKey(HKEY_LOCAL_MACHINE, DOMAIN_CACHE);
    queryCalls.enumValue = enumValue;
    enumerations = 0;
    BufStr<255> domain("before");
    for (bool says : {false, true}) {
        reports = says;
        nameWanted = dataWanted = ~DWORD{0};
        EXPECT_FALSE(Sys::FullDomain("SALES", domain));
        EXPECT_FALSE(Sys::ShortDomain("sales.example", domain));
    }
    EXPECT_LT(enumerations, 100);
    queryCalls.enumValue = [](HKEY, DWORD, char*, DWORD*, DWORD*, DWORD*, BYTE*, DWORD*) -> LSTATUS {
        return ERROR_ACCESS_DENIED;
    };
    EXPECT_FALSE(Sys::FullDomain("SALES", domain));
    EXPECT_STREQ(domain.c_str(), "before");
}

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

struct Profiles : RegistryTest {
    Profiles() {
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

} // namespace

TEST_F(Profiles, count_with_a_session_and_a_logon_name) {
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

TEST_F(Profiles, may_have_long_keys) {
    std::string const name = "zb_" + std::string(190, 'k');
    makeProfile(name, "jane");
    EXPECT_EQ(ownProfiles(), (Found{{name, "jane"}}));
}

namespace {

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

TEST_F(Profiles, are_read_again_with_more_room) {
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

TEST_F(Profiles, tell_who_sits_at_the_machine) {
    EXPECT_EQ(humanUser(), "thread") << "nobody has a session";
    makeProfile("zb_b", "jane");
    EXPECT_EQ(humanUser(), "jane");
    makeProfile("zb_a", "");
    EXPECT_EQ(humanUser(), "jane") << "an empty name is nobody's";
    makeProfile("zb_c", "john");
    EXPECT_EQ(humanUser(), "jane") << "the first one";
}

TEST_F(Profiles, are_all_there_is_for_accounts_of_the_machine) {
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

TEST_F(Profiles, belong_to_the_domains_that_they_name) {
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

TEST_F(Profiles, are_closed_10000_times) {
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

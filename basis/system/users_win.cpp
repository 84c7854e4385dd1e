// The sibling is users_posix.cpp.

#include "zor_basis/system/sys.h"

#include "basis/files/last_error.h"
#include "basis/system/profiles_win.h"
#include "basis/system/query_calls_win.h"
#include "basis/system/registry_win.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr DWORD NAME_ROOM = 512;

bool readComputerName(COMPUTER_NAME_FORMAT format, BufStr<15>& name) {
    char buffer[NAME_ROOM];
    DWORD n = NAME_ROOM;
    if (queryCalls.computerName(format, buffer, &n) == FALSE) return false;
    setBounded(name, buffer, NAME_ROOM);
    return true;
}

bool readThreadUser(BufStr<15>& user) {
    char buffer[NAME_ROOM];
    DWORD n = NAME_ROOM;
    if (queryCalls.userName(buffer, &n) == FALSE) return false;
    setBounded(user, buffer, NAME_ROOM);
    return true;
}

/// Accounts under which services run.
bool isMachine(BufStr<15> const& user) {
    if (_stricmp(user, "SYSTEM") == 0) return true;
    BufStr<15> computer;
    return readComputerName(ComputerNameNetBIOS, computer) && _stricmp(user, computer.add("$")) == 0;
}

} // namespace

bool Sys::CurrentUser(BufStr<15>& user, bool loggedOn) {
    user.clear();
    if (!loggedOn) return readThreadUser(user);
    return RegistryKey(HKEY_CURRENT_USER, "Software\\Microsoft\\Windows\\CurrentVersion\\Explorer")
        .read("Logon User Name", user);
}

bool Sys::CurrentDomain(BufStr<15>& domain, bool fromUser) {
    domain.clear();
    if (!fromUser) return readComputerName(ComputerNameDnsDomain, domain);
    // kept sys-01: most users belong to no domain, which is no failure.
    RegistryKey(HKEY_CURRENT_USER, "Volatile Environment").read("USERDNSDOMAIN", domain);
    domain.toLower();
    return true;
}

bool Sys::DefaultLogin(BufStr<15>& login) {
    login.clear();
    RegistryKey const key(HKEY_LOCAL_MACHINE, "SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion\\Winlogon");
    if (!key.read("DefaultUserName", login)) return false;
    BufStr<15> domain;
    // kept sys-02: only the existence of the domain value counts.
    if (key.read("DefaultDomainName", domain)) login.add("@").add(domain);
    return true;
}

bool Sys::CurHumanUser(BufStr<15>& user) {
    Profile profile;
    for (unsigned n = 0; profileOfSession(n, profile); ++n) {
        if (!profile.user.empty()) return user = profile.user, true;
    }
    user.clear();
    if (!readThreadUser(user)) return false;
    if (!user.empty() && !isMachine(user)) return true;
    user.clear();
    return refuse(Reason::NOT_FOUND);
}

} // namespace ZOR_Basis

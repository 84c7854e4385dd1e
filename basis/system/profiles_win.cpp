#include "basis/system/profiles_win.h"

#include "basis/ground/choices.h"
#include "basis/system/distinguished_name.h"
#include "basis/system/query_calls_win.h"
#include "basis/system/registry_win.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr char SESSION[] = "Volatile Environment";
constexpr char EXPLORER[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Explorer";
constexpr char LOGON_NAME[] = "Logon User Name";
constexpr char POLICY_STATE[] = "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\Group Policy\\State\\";

/// The name of the subkey at an index.
bool readKeyName(DWORD index, Blob& buffer, BufStr<255>& name) {
    buffer.alloc(VALUE_ROOM, DISCARDING_BYTES);
    for (;;) {
        DWORD n = static_cast<DWORD>(buffer.sizeBuf());
        LSTATUS const result =
            queryCalls.enumKey(HKEY_USERS, index, buffer.buf(), &n, nullptr, nullptr, nullptr, nullptr);
        if (result == ERROR_SUCCESS) return setBounded(name, buffer.val(), n), true;
        if (result != ERROR_MORE_DATA || !growBuffer(buffer, n)) return told(result);
    }
}

bool hasSession(HKEY profile) { return RegistryKey(profile, SESSION).isOpen(); }

/// Whether the profile counts, and whose it is.
bool readUser(BufStr<255> const& name, BufStr<15>& user) {
    RegistryKey const profile(HKEY_USERS, name);
    if (!profile.isOpen() || !hasSession(profile)) return false;
    Blob text;
    if (!RegistryKey(profile, EXPLORER).read(LOGON_NAME, text, RegistryKey::ONCE)) return false;
    setBounded(user, text.val(), text.size());
    return true;
}

bool isSame(char const* a, char const* b) { return _stricmp(a, b) == 0; }

BufStr<255> policyDomain(Profile const& profile) {
    BufStr<255> path(POLICY_STATE);
    path.add(profile.key);
    BufStr<255> name;
    RegistryKey(HKEY_LOCAL_MACHINE, path).read("Distinguished-Name", name);
    return domainOfDistinguishedName(name);
}

} // namespace

bool profileOfSession(unsigned n, Profile& profile) {
    Blob buffer;
    unsigned counted = 0;
    for (DWORD index = 0; readKeyName(index, buffer, profile.key); ++index) {
        if (readUser(profile.key, profile.user) && counted++ == n) return true;
    }
    profile.key.clear();
    profile.user.clear();
    return false;
}

bool isOfDomain(Profile const& profile, BufStr<15> const& domain) {
    BufStr<255> path(profile.key);
    path.add("\\").add(SESSION);
    RegistryKey const session(HKEY_USERS, path);
    bool named = false;
    for (char const* value : {"USERDNSDOMAIN", "USERDOMAIN"}) {
        BufStr<255> name;
        if (!session.read(value, name) || name.empty()) continue;
        if (isSame(name, domain)) return true;
        named = true;
    }
    if (named) return false;
    BufStr<255> const name = policyDomain(profile);
    return name.empty() || isSame(name, domain);
}

} // namespace ZOR_Basis

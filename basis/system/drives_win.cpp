// The sibling is drives_posix.cpp.

#include "zor_basis/system/sys.h"

#include "basis/files/last_error.h"
#include "basis/ground/choices.h"
#include "basis/system/profiles_win.h"
#include "basis/system/query_calls_win.h"
#include "basis/system/registry_win.h"

#include <algorithm>
#include <cctype>
#include <memory>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t LEAST_PATH_ROOM = 256;

/// "P:\", or whatever replaces it.
constexpr std::uint64_t DRIVE_LENGTH = 3;

bool isLocalKind(UINT kind) { return kind == DRIVE_FIXED || kind == DRIVE_CDROM || kind == DRIVE_RAMDISK; }

bool isOnLocalVolume(BufStr<255> const& path) {
    Blob volume;
    volume.alloc(std::max(LEAST_PATH_ROOM, path.size() + 1), DISCARDING_BYTES);
    return volume.buf() != nullptr &&
           queryCalls.volumePath(path, volume.buf(), static_cast<DWORD>(volume.sizeBuf())) != FALSE &&
           isLocalKind(queryCalls.driveType(volume.val()));
}

/// The first characters of a path, or as many as there are.
BufStr<15> front(BufStr<255> const& path, std::uint64_t n) {
    BufStr<15> text;
    setPart(text, path.c_str(), path.c_str() + std::min(n, path.size()));
    return text;
}

char letterOf(BufStr<255> const& path) {
    return static_cast<char>(std::toupper(static_cast<unsigned char>(path.first())));
}

/// Replaces the drive by what stands for it.
void unmapTo(char const* remote, BufStr<255> const& path, FPath& unc) {
    // kept sys-06: what stands before the path on the drive is three characters wide, slash or not.
    char const* rest = path.c_str() + std::min(DRIVE_LENGTH, path.size());
    while (FPath::isSlash(*rest)) ++rest;
    unc = FPath(remote, rest);
}

/// By the mappings under a user's key.
bool unmapByKey(HKEY parent, char const* prefix, BufStr<255> const& path, FPath& unc) {
    if (path.empty()) return refuse(Reason::BAD_ARGUMENT);
    BufStr<255> name(prefix);
    name.add("Network\\").add(letterOf(path));
    BufStr<255> remote;
    if (!RegistryKey(parent, name).read("RemotePath", remote)) return false;
    unmapTo(remote, path, unc);
    return true;
}

bool unmapByProfile(Profile const& profile, BufStr<255> const& path, FPath& unc) {
    BufStr<255> prefix(profile.key);
    return unmapByKey(HKEY_USERS, prefix.add("\\"), path, unc);
}

/// By the connections of the calling thread.
bool unmapByConnection(BufStr<255> const& path, FPath& unc) {
    if (path.empty()) return refuse(Reason::BAD_ARGUMENT);
    BufStr<15> drive;
    drive.add(letterOf(path)).add(":");
    Blob remote;
    remote.alloc(VALUE_ROOM, DISCARDING_BYTES);
    for (;;) {
        DWORD n = static_cast<DWORD>(remote.sizeBuf());
        DWORD const result = queryCalls.connection(drive, remote.buf(), &n);
        if (result == ERROR_MORE_DATA && growBuffer(remote, n)) continue;
        if (!told(static_cast<LSTATUS>(result))) return false;
        unmapTo(remote.val(), path, unc);
        return true;
    }
}

bool isUsers(Profile const& profile, BufStr<15> const& user, bool hasDomain, BufStr<15> const& domain) {
    return _stricmp(profile.user, user) == 0 && (!hasDomain || domain.empty() || isOfDomain(profile, domain));
}

} // namespace

bool Sys::isLocalDisk(Str const& path) {
    BufStr<255> const text(path);
    if (isOnLocalVolume(text)) return true;
    BufStr<255> device("\\DosDevices\\");
    // kept sys-05: the machine gave the letter to a disk of its own.
    return RegistryKey(HKEY_LOCAL_MACHINE, "SYSTEM\\MountedDevices").has(device.add(front(text, 2)));
}

bool Sys::UnMap(Str const& path, FPath& unc) { return unmapByKey(HKEY_CURRENT_USER, "", path, unc); }

bool Sys::UnMap(Str const& path, Str const& user, FPath& unc) {
    if (user.empty()) return UnMap(path, unc);
    BufStr<15> name, domain;
    bool const hasDomain = ParseUser(user, name, domain);
    Profile profile;
    for (unsigned n = 0; profileOfSession(n, profile); ++n) {
        if (isUsers(profile, name, hasDomain, domain) && unmapByProfile(profile, path, unc)) return true;
    }
    return false;
}

bool Sys::UnMap(Str const& path, Str const& user, Str const& password, FPath& unc) {
    if (UnMap(path, user, unc)) return true;
    constexpr bool INTERACTIVE = true;
    std::unique_ptr<SysHdl> const handle(loginUser(user, password, INTERACTIVE));
    if (handle == nullptr) return false;
    bool const found = impersonate(handle.get()) && unmapByConnection(path, unc);
    KeepLastError const whyNotFound;
    revertToSelf();
    return found;
}

bool Sys::UnMapLogin(Str const& path, FPath& unc) {
    Profile profile;
    for (unsigned n = 0; profileOfSession(n, profile); ++n) {
        if (unmapByProfile(profile, path, unc)) return true;
    }
    return unmapByConnection(path, unc);
}

} // namespace ZOR_Basis

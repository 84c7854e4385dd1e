/// \file
/// `Sys`: queries about the system that the component runs on.
///
/// It tells the root folder and the temporary folder of the installation, users and domains, local disks and network
/// shares, and it logs users on and acts on their behalf. Only the root is cached; every other query asks the system.
///
/// | query | Windows | Linux |
/// |---|---|---|
/// | users | registry, the thread's user | password database, the thread's and the process's user |
/// | domains | registry, the computer's DNS domain | the resolver's domain |
/// | default logon, domain cache | registry | not available: false |
/// | logging on | `LogonUser` | PAM, service "zor_basis" |
/// | acting as a user | impersonation | user, group and supplementary groups of the calling thread |
/// | disks and shares | volumes, drive mappings | the mount table |
///
///     std::unique_ptr<SysHdl> user(Sys::loginUser("user@domain", password, true));
///     if (user && Sys::impersonate(user.get())) {
///         read(path);
///         Sys::revertToSelf();
///     }
///
/// A registry value that is longer than 512 bytes, or whose type is not text, counts as missing unless a function says
/// otherwise.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread thread-safe. Acting as a user affects the calling thread only; on Linux, threads that it starts meanwhile
///     inherit the user

#ifndef ZOR_BASIS_SYSTEM_SYS_H
#define ZOR_BASIS_SYSTEM_SYS_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/system/sys_hdl.h"
#include "zor_basis/text/buf_str.h"

namespace ZOR_Basis {

class ZB_API Sys {
public:
    /// \name Folders
    /// Paths use forward slashes and do not end in one.
    /// @{

    /// Returns the root folder: the one that the platform layer is configured with, otherwise the folder that is
    /// current at the first call. The function removes one trailing slash and then a last component "system", so that
    /// the parent of "system" becomes the root.
    /// \kept root-01: if the current folder's path has 512 bytes or more, the first call returns the empty path. Each
    ///     failing call doubles the buffer for the next one: the second call finds a path of 512 to 1,023 bytes, the
    ///     third one of up to 2,047
    /// \return a path that lives as long as the process and never changes. While there is no root it is the empty path,
    ///     and a reference to that stays empty when a root is found later, so call again instead of keeping it. On
    ///     Linux a root of "/" is also the empty path; the paths that the library builds from it are absolute
    ///     nonetheless ("/tmp", "/timer")
    /// \thread any; one thread asks the system, the others wait for the answer
    /// \cost one query of the system for the process; while the root is empty one for each call, by one thread at a
    ///     time
    static FPath const& root();
    /// Copies the root.
    /// \return whether it is not empty
    static bool root(FPath& out);

    /// Returns the folder "tmp" in the root folder. The folder need not exist.
    /// \return a path that lives as long as the process; while the root is empty, it lives until the thread's next call
    static FPath const& temp();
    /// @}

    /// \name Users and domains
    /// Unless a function says otherwise, it clears its outputs first, and they stay empty if the query fails. An output
    /// must not be one of the input texts.
    /// @{

    /// Gets a user's name.
    /// \param loggedOn  asks for the user of the session: on Windows the value "Logon User Name" of the key
    ///     HKEY_CURRENT_USER\Software\Microsoft\Windows\CurrentVersion\Explorer, where an empty value counts as
    ///     success; on Linux the process's real user. False asks for the user as whom the calling thread acts
    static bool CurrentUser(BufStr<15>& user, bool loggedOn);

    /// Gets a DNS domain.
    /// \param fromUser  asks for the user's domain, in lower case: on Windows "USERDNSDOMAIN" of
    ///     HKEY_CURRENT_USER\Volatile Environment. False asks for the computer's domain. On Linux both are the domain
    ///     with which the resolver completes names
    /// \kept sys-01: if the user's domain is missing, the result is true and the text is empty. The computer's domain
    ///     gives false only if the system call fails
    static bool CurrentDomain(BufStr<15>& domain, bool fromUser);

    /// Gets the user whom Windows logs on automatically: "DefaultUserName" of
    /// HKEY_LOCAL_MACHINE\SOFTWARE\Microsoft\Windows NT\CurrentVersion\Winlogon, followed by "@" and
    /// "DefaultDomainName" if that value exists.
    /// \kept sys-02: a domain value that exists but is empty gives "user@"
    /// \return whether there is a user name; always false on Linux
    static bool DefaultLogin(BufStr<15>& login);

    /// Splits a qualified user name: "user@domain" at its first "@"; otherwise "domain\user", or else "domain/user", at
    /// the first separator. Either half may be empty. The empty name stands for the thread's user and the computer's
    /// domain.
    /// \kept sys-03: if the name has no domain, the whole text is the user, `domain` is unchanged, and the result is
    ///     false
    /// \return true if the name was split; for the empty name, the result of `CurrentUser`
    static bool ParseUser(Str const& full, BufStr<15>& user, BufStr<15>& domain);

    /// Tells whether a domain's name contains a full stop, which makes it a DNS name rather than a short name.
    static bool isCompositeName(Str const& name);

    /// Translate between the short name of a domain and its DNS name by the values of
    /// HKEY_LOCAL_MACHINE\SOFTWARE\Microsoft\Windows NT\CurrentVersion\Winlogon\DomainCache: a value's name is the
    /// short name, its text the DNS name. Names may have any length.
    /// \kept sys-04: the comparison is case-sensitive
    /// \return whether the name was found; if not, `domain` is unchanged. Always false on Linux
    static bool FullDomain(Str const& name, BufStr<255>& domain);
    static bool ShortDomain(Str const& name, BufStr<255>& domain);

    /// Gets the user who sits at the machine. On Windows that is the logon name of the first profile under HKEY_USERS
    /// that has an interactive session ("Volatile Environment") and a logon name that is not empty; on Linux the first
    /// user with a session on a terminal of the machine. If there is none it is the thread's user, unless that account
    /// does not belong to a person: on Windows "SYSTEM" and the computer's account, its name with "$".
    /// \return false if there is no such user
    static bool CurHumanUser(BufStr<15>& user);
    /// @}

    /// \name Acting as a user
    /// @{

    /// Logs a user on. This also ends any impersonation by the calling thread, unless `user` is empty.
    /// \param user  has a form that `ParseUser` understands. On Linux a user of a domain is looked up as "user@domain"
    /// \param password  is only passed through
    /// \param interactive  requests a full logon. False requests, on Windows, a token that identifies the user only to
    ///     other machines; the password is not checked locally. On Linux both request a full logon
    /// \return a handle owned by the caller; null if the user is empty or the logon is refused
    static SysHdl* loginUser(Str const& user, Str const& password, bool interactive);

    /// Makes the calling thread impersonate the user, instead of any earlier one. Null ends impersonation, as
    /// `revertToSelf` does, and returns true.
    /// \pre a valid handle comes from `loginUser`
    /// \error false if the handle is invalid or the system refuses; the thread then impersonates nobody. Linux requires
    ///     the privilege to change ids
    static bool impersonate(SysHdl* handle);
    /// Ends impersonation; true also if there was none.
    static bool revertToSelf();
    /// @}

    /// \name Disks and shares
    /// @{

    /// Tells whether a path lies on a fixed disk, an optical disk or a RAM disk. The path need not exist. Removable
    /// disks, remote disks and disks of unknown kind are not local.
    /// \kept sys-05: on Windows the result is also true if "\DosDevices\" plus the first two characters of the path
    ///     names a value of HKEY_LOCAL_MACHINE\SYSTEM\MountedDevices, so a removable drive may count as local
    /// \cost on Linux one reading of the mount table
    static bool isLocalDisk(Str const& path);

    /// Translate a path on a mapped drive into the network path that it stands for: "p:\jobs\1" gives
    /// "\\srv\share/jobs\1" if "\\srv\share" is mapped to P. On Linux a path below a mounted share gives
    /// "//srv/share/rest".
    ///
    /// Each form searches in the order given here; the first mapping of the drive decides:
    /// - `UnMap(path, unc)`: the mappings of the current user, HKEY_CURRENT_USER\Network\LETTER\RemotePath.
    /// - with a user: the mappings in the user's profile under HKEY_USERS. A profile belongs to the user if its logon
    ///   name matches in any case, and its domain matches too where both the qualified name and the profile have one.
    ///   The profile's domain is "USERDNSDOMAIN" or "USERDOMAIN", or else comes from the user's distinguished name in
    ///   the state of the group policy. An empty user means the current one.
    /// - with a password: the user's profile as above; otherwise the function logs the user on, impersonates that user
    ///   to query the live connections, and ends impersonation.
    /// - `UnMapLogin`: the profiles of all users with an interactive session, in the order of the listing; otherwise
    ///   the live connections of the calling thread.
    ///
    /// On Linux shares are mounted for all users, so all forms return the same.
    /// \kept sys-06: the first three characters of the path are removed, whatever they are, and all slashes that follow
    ///     them
    /// \return false, with `unc` unchanged, if the drive is not mapped
    static bool UnMap(Str const& path, FPath& unc);
    static bool UnMap(Str const& path, Str const& user, FPath& unc);
    static bool UnMap(Str const& path, Str const& user, Str const& password, FPath& unc);
    static bool UnMapLogin(Str const& path, FPath& unc);
    /// @}
};

} // namespace ZOR_Basis

#endif

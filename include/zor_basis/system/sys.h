/// \file
/// `Sys`: what there is to know about the system that the component runs on.
///
/// The root folder and the temporary folder of the installation; users and domains; logging a user on and acting as that
/// user; local disks and network shares. Nothing is cached but the root: every query asks the system.
///
/// | query | Windows | Linux |
/// |---|---|---|
/// | users | registry, the thread's user | password database, the thread's and the process's user |
/// | domains | registry, the computer's DNS domain | the resolver's domain |
/// | default logon, domain cache | registry | there is none: false |
/// | logging on | `LogonUser` | PAM, service "zor_basis" |
/// | acting as a user | impersonation | user, group and supplementary groups of the calling thread |
/// | disks and shares | volumes, drive mappings | the mount table |
///
/// A registry value longer than 512 bytes, or of a type that is no text, counts as missing unless told otherwise.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  thread-safe. Acting as a user is a matter of the calling thread alone; on Linux threads that it starts
///     meanwhile inherit it

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
    /// Paths have forward slashes and none at the end.
    /// @{

    /// The root folder: the one that the platform layer is configured with, else the current folder at the first call.
    /// One slash at its end is taken away, and then a last component "system", so that the parent of that is the root.
    /// \kept root-01: a current folder of 512 bytes or more gives the empty path at the first call. Each call that fails
    ///     doubles the room for the next one: 512 to 1,023 bytes are found by the second call, up to 2,047 by the third
    /// \return a path that lives as long as the process and never changes; the empty path while there is none: that
    ///         reference stays empty when a root is found later, so ask again instead of keeping it. On Linux a root of "/" is
    ///         the empty path too; what is made from it is absolute nonetheless ("/tmp", "/timer")
    /// \thread any; one thread asks the system, the others wait for its answer
    /// \cost the system is asked once, or, while the root is empty, at each call, by one thread at a time
    static FPath const& root();
    /// Copies the root. \return whether it is not empty
    static bool root(FPath& out);

    /// The folder "tmp" in the root folder. It need not exist.
    /// \return a path that lives as long as the process; while the root is empty, as long as the thread's next call
    static FPath const& temp();
    /// @}

    /// \name Users and domains
    /// The outputs are cleared first, unless told otherwise, and stay so where the query fails. An output is never one of
    /// the texts that are handed in.
    /// @{

    /// A user's name.
    /// \param loggedOn  the user of the session: on Windows the value "Logon User Name" of the key
    ///     HKEY_CURRENT_USER\Software\Microsoft\Windows\CurrentVersion\Explorer, where an empty one is as good; on Linux
    ///     the process's real user. Otherwise the user as whom the calling thread acts
    static bool CurrentUser(BufStr<15>& user, bool loggedOn);

    /// A DNS domain.
    /// \param fromUser  the user's, in lower case: on Windows "USERDNSDOMAIN" of HKEY_CURRENT_USER\Volatile Environment.
    ///     Otherwise the computer's. On Linux both are that with which the resolver completes names
    /// \kept sys-01: the user's domain may be missing: the result is true and the text empty. Of the computer's domain only
    ///     a failing system gives false
    static bool CurrentDomain(BufStr<15>& domain, bool fromUser);

    /// The user whom Windows logs on by itself: "DefaultUserName" of HKEY_LOCAL_MACHINE\SOFTWARE\Microsoft\Windows
    /// NT\CurrentVersion\Winlogon, with "@" and "DefaultDomainName" behind it where there is that.
    /// \kept sys-02: a domain that is there and empty gives "user@"
    /// \return whether there is a user name; on Linux false
    static bool DefaultLogin(BufStr<15>& login);

    /// Takes a qualified user name apart: "user@domain" at its first "@"; else "domain\user", or else "domain/user", at its
    /// first separator. Either half may be empty. The empty name is the thread's user and the computer's domain.
    /// \kept sys-03: without a domain in it the whole text is the user, `domain` stays as it was, and the result is false
    /// \return true where it has been taken apart; for the empty name, what `CurrentUser` returned
    static bool ParseUser(Str const& full, BufStr<15>& user, BufStr<15>& domain);

    /// Whether a domain's name contains a full stop and so is a DNS name rather than a short one.
    static bool isCompositeName(Str const& name);

    /// Translates between the short name of a domain and its DNS name, by the values of
    /// HKEY_LOCAL_MACHINE\SOFTWARE\Microsoft\Windows NT\CurrentVersion\Winlogon\DomainCache: each is named by the short
    /// name and holds the other. Names may be of any length.
    /// \kept sys-04: upper and lower case differ
    /// \return whether the name is there; if not, `domain` stays as it was. On Linux false
    static bool FullDomain(Str const& name, BufStr<255>& domain);
    static bool ShortDomain(Str const& name, BufStr<255>& domain);

    /// The user who sits at the machine. On Windows that is the logon name of the first profile under HKEY_USERS that has
    /// an interactive session ("Volatile Environment") and a logon name that is not empty; on Linux the first user with a
    /// session on a terminal of the machine. Where there is none it is the thread's user, unless that is no human's account:
    /// on Windows "SYSTEM" and that of the computer, its name with "$".
    /// \return false where there is no such user
    static bool CurHumanUser(BufStr<15>& user);
    /// @}

    /// \name Acting as a user
    /// @{

    /// Logs a user on. Whoever the calling thread acts as, it is itself again from then on, unless `user` is empty.
    /// \param user  as for `ParseUser`. On Linux a user of a domain is asked for as "user@domain"
    /// \param password  only passed through
    /// \param interactive  on Windows: a full logon; otherwise a token with which the user is that only towards other
    ///     machines, and the password is not checked here. On Linux both are a full logon
    /// \return a handle owned by the caller; null for an empty user and where the logon is refused
    static SysHdl* loginUser(Str const& user, Str const& password, bool interactive);

    /// Has the calling thread act as the user, and no longer as one before. Null ends that, as `revertToSelf` does, and is
    /// true.
    /// \pre a handle that is valid comes from `loginUser`
    /// \error false for an invalid handle and where the system refuses; the thread is itself then. On Linux it takes the
    ///     privilege to change ids
    static bool impersonate(SysHdl* handle);
    /// Has the calling thread be itself again. True also where it was.
    static bool revertToSelf();
    /// @}

    /// \name Disks and shares
    /// @{

    /// Whether a path lies on a fixed disk, an optical or a RAM disk. It need not exist. Removable disks, remote ones and
    /// those of unknown kind are not local.
    /// \kept sys-05: on Windows it is also true where "\DosDevices\" with the first two characters of the path names a value
    ///     of HKEY_LOCAL_MACHINE\SYSTEM\MountedDevices, so that a removable drive may be local
    /// \cost on Linux the mount table is read
    static bool isLocalDisk(Str const& path);

    /// Turns a path on a mapped drive into the network path for which it stands: "p:\jobs\1" gives "\\srv\share/jobs\1"
    /// where "\\srv\share" is mapped to P. On Linux a path below a mounted share gives "//srv/share/rest".
    ///
    /// The forms look in this order; the first that finds the drive decides:
    /// - `UnMap(path, unc)`: the mappings of the current user, HKEY_CURRENT_USER\Network\LETTER\RemotePath.
    /// - with a user: those in the user's profile under HKEY_USERS. A profile is the user's if its logon name is (in any
    ///   case) and its domain too, where both the qualified name and the profile have one (the profile by "USERDNSDOMAIN" or
    ///   "USERDOMAIN", or else by the user's distinguished name in the state of the group policy). An empty user is the
    ///   current one.
    /// - with a password: the user's profile as before; else the user is logged on and the calling thread acts as that
    ///   user while it asks for the live connections, and is itself afterwards.
    /// - `UnMapLogin`: the profiles of all users with an interactive session, in the order in which they are listed; else
    ///   the live connections of the calling thread.
    ///
    /// On Linux shares are mounted for all users, so all forms give the same.
    /// \kept sys-06: the first three characters of the path go, and all slashes behind them, whatever they are
    /// \return false, with `unc` as it was, where the drive is not mapped
    static bool UnMap(Str const& path, FPath& unc);
    static bool UnMap(Str const& path, Str const& user, FPath& unc);
    static bool UnMap(Str const& path, Str const& user, Str const& password, FPath& unc);
    static bool UnMapLogin(Str const& path, FPath& unc);
    /// @}
};

} // namespace ZOR_Basis

#endif

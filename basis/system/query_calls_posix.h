/// \file
/// The Linux calls of the system queries, in one table, so that tests can make each call fail.

#ifndef BASIS_SYSTEM_QUERY_CALLS_POSIX_H
#define BASIS_SYSTEM_QUERY_CALLS_POSIX_H

#include "zor_basis/text/buf_str.h"

#include <pwd.h>
#include <security/pam_appl.h>
#include <sys/types.h>

namespace ZOR_Basis {

struct QueryCalls {
    /// Ids of the process and of the calling thread.
    uid_t (*realUser)();
    uid_t (*effectiveUser)();
    gid_t (*effectiveGroup)();
    /// The C library's functions for the password and group databases.
    int (*userById)(uid_t, passwd*, char*, std::size_t, passwd**);
    int (*userByName)(char const*, passwd*, char*, std::size_t, passwd**);
    int (*groupsOf)(char const*, gid_t, gid_t*, int*);
    int (*groups)(int, gid_t*);
    /// Change the calling thread alone, unlike those of the C library.
    /// \return whether they succeeded
    bool (*setGroups)(std::size_t, gid_t const*);
    bool (*setEffectiveGroup)(gid_t);
    bool (*setEffectiveUser)(uid_t);
    int (*pamStart)(char const* service, char const* user, pam_conv const*, pam_handle_t**);
    /// The domain with which the resolver completes names; empty where there is none.
    bool (*resolverDomain)(BufStr<15>& domain);
    /// The table of what is mounted, and the records of who is logged on.
    char const* mountTable;
    char const* sessions;
};

/// Replaced by tests only, while nothing else runs.
extern QueryCalls queryCalls;

} // namespace ZOR_Basis

#endif

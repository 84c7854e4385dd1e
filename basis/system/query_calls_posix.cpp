// The sibling is query_calls_win.cpp.

#include "basis/system/query_calls_posix.h"

#include <grp.h>
#include <paths.h>
#include <resolv.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr gid_t SAME_GROUP = ~gid_t{0};
constexpr uid_t SAME_USER = ~uid_t{0};

bool setGroups(std::size_t n, gid_t const* groups) { return syscall(SYS_setgroups, n, groups) == 0; }

bool setEffectiveGroup(gid_t group) { return syscall(SYS_setresgid, SAME_GROUP, group, SAME_GROUP) == 0; }

bool setEffectiveUser(uid_t user) { return syscall(SYS_setresuid, SAME_USER, user, SAME_USER) == 0; }

bool resolverDomain(BufStr<15>& domain) {
    struct __res_state state;
    std::memset(&state, 0, sizeof state);
    if (res_ninit(&state) != 0) return false;
    domain = state.dnsrch[0];
    res_nclose(&state);
    if (domain == Str(".")) domain.clear(); // the root: names are complete as they are
    return true;
}

} // namespace

QueryCalls queryCalls{
    getuid,    geteuid,           getegid,          getpwuid_r, getpwnam_r,     getgrouplist,        getgroups,
    setGroups, setEffectiveGroup, setEffectiveUser, pam_start,  resolverDomain, "/proc/self/mounts", _PATH_UTMP};

} // namespace ZOR_Basis

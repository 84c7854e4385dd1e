#include "basis/system/identity_posix.h"

#include "basis/files/last_error.h"
#include "basis/system/query_calls_posix.h"

#include <new>

namespace ZOR_Basis {
namespace {

constexpr int FEW = 16;
/// As many supplementary groups as the kernel keeps for a thread.
constexpr int MOST = 65536;

} // namespace

bool Identity::makeRoom(int n) {
    groups_.reset(new (std::nothrow) gid_t[static_cast<std::size_t>(n) + 1]);
    count_ = 0;
    return groups_ != nullptr || refuse(Reason::NO_MEMORY);
}

bool Identity::readOwn() {
    user_ = queryCalls.effectiveUser();
    group_ = queryCalls.effectiveGroup();
    int const n = queryCalls.groups(0, nullptr);
    if (n < 0 || !makeRoom(n)) return false;
    int const read = queryCalls.groups(n, groups_.get());
    if (read < 0) return false;
    count_ = static_cast<std::size_t>(read);
    return true;
}

bool Identity::read(Account const& account) {
    user_ = account.user;
    group_ = account.group;
    for (int room = FEW; room <= MOST; room *= 4) {
        if (!makeRoom(room)) return false;
        int n = room;
        if (queryCalls.groupsOf(account.name, account.group, groups_.get(), &n) >= 0) {
            count_ = static_cast<std::size_t>(n);
            return true;
        }
    }
    return refuse(Reason::NO_MEMORY);
}

bool Identity::setGroups() const { return queryCalls.setGroups(count_, groups_.get()); }

bool Identity::take(Identity const& own) const {
    // The user last: with it the privilege to change anything goes.
    if (!setGroups()) return false;
    bool const hasGroup = queryCalls.setEffectiveGroup(group_);
    if (hasGroup && queryCalls.setEffectiveUser(user_)) return true;
    KeepLastError const whyNotTaken;
    if (hasGroup) queryCalls.setEffectiveGroup(own.group_);
    own.setGroups();
    return false;
}

bool Identity::takeBack() const {
    return queryCalls.setEffectiveUser(user_) && queryCalls.setEffectiveGroup(group_) && setGroups();
}

} // namespace ZOR_Basis

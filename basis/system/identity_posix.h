/// \file
/// As whom a thread acts: its effective user and group, and its supplementary groups.

#ifndef BASIS_SYSTEM_IDENTITY_POSIX_H
#define BASIS_SYSTEM_IDENTITY_POSIX_H

#include "basis/system/accounts_posix.h"

#include <sys/types.h>

#include <cstddef>
#include <memory>

namespace ZOR_Basis {

class Identity {
public:
    /// That of the calling thread, and that of an account. \return whether the system told
    bool readOwn();
    bool read(Account const& account);

    /// Has the calling thread, whose identity is `own`, act so. Only a privileged thread can.
    /// \return false where the system refuses; the thread acts as before then
    bool take(Identity const& own) const;
    /// Has the calling thread act so again, as it once did.
    bool takeBack() const;

private:
    bool makeRoom(int n);
    bool setGroups() const;

    uid_t user_ = 0;
    gid_t group_ = 0;
    std::unique_ptr<gid_t[]> groups_;
    std::size_t count_ = 0;
};

} // namespace ZOR_Basis

#endif

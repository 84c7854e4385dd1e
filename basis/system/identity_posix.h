/// \file
/// The identity of a thread: its effective user and group, and its supplementary groups.

#ifndef BASIS_SYSTEM_IDENTITY_POSIX_H
#define BASIS_SYSTEM_IDENTITY_POSIX_H

#include "basis/system/accounts_posix.h"

#include <sys/types.h>

#include <cstddef>
#include <memory>

namespace ZOR_Basis {

class Identity {
public:
    /// Get the identity of the calling thread, and that of an account.
    /// \return whether the system knows it
    bool readOwn();
    bool read(Account const& account);

    /// Makes the calling thread, whose identity is `own`, take this identity. Requires privileges.
    /// \return false if the system refuses; the thread's identity is then unchanged
    bool take(Identity const& own) const;
    /// Restores this identity, which the calling thread had before.
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

/// \file
/// `ISemSet`: the interface of a set of locks by number. A `SemSet` holds one.
///
/// \thread thread-safe, except destruction

#ifndef ZOR_BASIS_SYNC_I_SEM_SET_H
#define ZOR_BASIS_SYNC_I_SEM_SET_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API ISemSet {
public:
    ISemSet() = default;
    ISemSet(ISemSet const&) = delete;
    ISemSet& operator=(ISemSet const&) = delete;
    virtual ~ISemSet();

    /// Locks a key; waits without limit. The holder may take the key again.
    /// \return false if the platform layer fails. Every `take` that reached the key's own mutex must be matched by a
    ///     `give`, even one that failed there; otherwise the key's entry stays until the set is destroyed
    virtual bool take(std::uint64_t key) = 0;
    /// Unlocks a key.
    /// \pre this thread has taken the key
    /// \return false if the platform layer fails, and for a key that is not taken
    virtual bool give(std::uint64_t key) = 0;
};

} // namespace ZOR_Basis

#endif

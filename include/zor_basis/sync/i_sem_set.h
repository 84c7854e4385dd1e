/// \file
/// `ISemSet`: what a set of locks by number offers. Held by a `SemSet`.
///
/// \thread  thread-safe, destruction excepted

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

    /// Locks a key; waits without limit. The holder may take it again.
    /// \return false where the platform layer fails. Every take that reached the key's own mutex wants its `give`, even
    ///         one that failed there, or the key's book-keeping stays until the set is destroyed
    virtual bool take(std::uint64_t key) = 0;
    /// Unlocks a key. \pre this thread took it
    /// \return false where the platform layer fails, and for a key that nobody took
    virtual bool give(std::uint64_t key) = 0;
};

} // namespace ZOR_Basis

#endif

/// \file
/// `SemSet`: locks by number, for as many objects as there are, without a lock for each of them.
///
///     SemSet jobs(1000);
///     if (jobs->take(jobNumber)) { ...; jobs->give(jobNumber); }
///
/// A key has a mutex of its own from the first `take` to the last `give`. Keys are spread over buckets; two that share
/// one share only a moment of book-keeping, never their mutexes.
///
/// \thread  thread-safe, construction and destruction excepted

#ifndef ZOR_BASIS_SYNC_SEM_SET_H
#define ZOR_BASIS_SYNC_SEM_SET_H

#include "zor_basis/export.h"

#include <cstddef>
#include <cstdint>

namespace ZOR_Basis {

/// What a set of locks offers.
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

class ZB_API SemSet {
public:
    /// \param size  keys that are held at once, roughly: there are as many buckets as the largest prime not above the
    ///        largest power of 2 not above it. 0 and 1 give one bucket
    /// \error  without memory for the buckets nothing can be taken
    explicit SemSet(std::size_t size);
    /// For 31 keys, in 13 buckets.
    SemSet() : SemSet(31) {}
    SemSet(SemSet const&) = delete;
    /// Shares the set; both objects delete it, so that one in use is never assigned, and what this one had is lost.
    SemSet& operator=(SemSet const& other);
    ~SemSet();

    ISemSet* operator->() const { return set_; }

private:
    ISemSet* set_;
};

} // namespace ZOR_Basis

#endif

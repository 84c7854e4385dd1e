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
#include "zor_basis/sync/i_sem_set.h"

#include <cstddef>

namespace ZOR_Basis {

class ZB_API SemSet {
public:
    /// \param size  keys that are held at once, roughly: there are as many buckets as the largest prime not above the
    ///        largest power of 2 not above it. 0 and 1 give one bucket
    /// \error  without memory for the buckets nothing can be taken
    SemSet(std::size_t size);
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

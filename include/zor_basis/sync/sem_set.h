/// \file
/// `SemSet`: locks by number, for any number of objects, without a permanent lock for each of them.
///
///     SemSet jobs(1000);
///     if (jobs->take(jobNumber)) { render(); jobs->give(jobNumber); }
///
/// A key has its own mutex from the first `take` to the last `give`. Keys are spread over buckets; two keys in one
/// bucket share only brief book-keeping, never a mutex.
///
/// \thread thread-safe, except construction and destruction

#ifndef ZOR_BASIS_SYNC_SEM_SET_H
#define ZOR_BASIS_SYNC_SEM_SET_H

#include "zor_basis/export.h"
#include "zor_basis/sync/i_sem_set.h"

#include <cstddef>

namespace ZOR_Basis {

class ZB_API SemSet {
public:
    /// \param size  is roughly the number of keys held at the same time. The number of buckets is the largest prime not
    ///     above the largest power of 2 not above `size`. 0 and 1 give one bucket
    /// \error if memory for the buckets is short, no key can be taken
    SemSet(std::size_t size);
    /// Makes a set for 31 keys, with 13 buckets.
    SemSet() : SemSet(31) {}
    SemSet(SemSet const&) = delete;
    /// Shares the other's set. Both objects delete it, so a set in use must not be assigned; the set that this object
    /// had is leaked.
    SemSet& operator=(SemSet const& other);
    ~SemSet();

    /// \return the set; null if memory was too short for the set itself
    ISemSet* operator->() const { return set_; }

private:
    ISemSet* set_;
};

} // namespace ZOR_Basis

#endif

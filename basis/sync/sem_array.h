/// \file
/// `SemArray`: a set of locks as a table of buckets.

#ifndef BASIS_SYNC_SEM_ARRAY_H
#define BASIS_SYNC_SEM_ARRAY_H

#include "basis/sync/sem_syn_list.h"
#include "zor_basis/sync/i_sem_set.h"

namespace ZOR_Basis {

class SemArray final : public ISemSet {
public:
    explicit SemArray(std::size_t size);
    ~SemArray() override;

    bool take(std::uint64_t key) override;
    bool give(std::uint64_t key) override;

    std::uint64_t bucketCount() const { return count_; }
    /// The bucket of a key; null if memory was short when the table was made.
    SemSynList* bucketOf(std::uint64_t key) const { return buckets_ != nullptr ? &buckets_[key % count_] : nullptr; }

    /// The buckets for a number of keys.
    static std::uint64_t bucketsFor(std::size_t size);

private:
    SemSynList* buckets_;
    std::uint64_t count_;
};

} // namespace ZOR_Basis

#endif

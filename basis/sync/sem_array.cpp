#include "basis/sync/sem_array.h"

#include "zor_basis/ground/hashing.h"

#include <algorithm>
#include <new>

namespace ZOR_Basis {

std::uint64_t SemArray::bucketsFor(std::size_t size) {
    constexpr std::uint64_t LAST_ROW = 30;
    return PrimeClsPo2(std::min(Log2(size), LAST_ROW));
}

SemArray::SemArray(std::size_t size)
    : buckets_(new (std::nothrow) SemSynList[bucketsFor(size)]), count_(bucketsFor(size)) {}

SemArray::~SemArray() { delete[] buckets_; }

bool SemArray::take(std::uint64_t key) {
    SemSynList* const bucket = bucketOf(key);
    return bucket != nullptr && bucket->take(key);
}

bool SemArray::give(std::uint64_t key) {
    SemSynList* const bucket = bucketOf(key);
    return bucket != nullptr && bucket->give(key);
}

} // namespace ZOR_Basis

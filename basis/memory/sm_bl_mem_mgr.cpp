#include "basis/memory/sm_bl_mem_mgr.h"

#include "zor_basis/ground/hashing.h"
#include "zor_basis/ground/loads.h"

#include <algorithm>
#include <cstring>
#include <utility>

#include <xmmintrin.h>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t FEWEST_ELEMENTS = 16;
constexpr std::uint64_t LARGEST_FIRST_CHUNK = 20; // as powers of 2
constexpr std::uint64_t LARGEST_CHUNK = 22;
constexpr std::uint64_t GROWTH = 4;

std::uint64_t alignment(std::uint64_t wanted) { return wanted < 4 ? 2 : wanted < 8 ? 4 : 8; }

std::uint64_t roundedUp(std::uint64_t size, std::uint64_t align) {
    std::uint64_t const most = ~std::uint64_t{0} - align + 1; // rounded up, more would come out small
    return (std::min(size, most) + align - 1) / align * align;
}

/// The power of 2 above a number of bytes, at most 2^limit.
std::uint64_t chunkFor(std::uint64_t bytes, std::uint64_t limit) { return Pow2(std::min(Log2(bytes) + 1, limit)); }

std::uint64_t product(std::uint64_t a, std::uint64_t b) {
    return a != 0 && b > ~std::uint64_t{0} / a ? ~std::uint64_t{0} : a * b;
}

// A freed element's first word is the address of the next one; it need not be aligned for a pointer.
char* nextOf(char const* element) { return detail::loadWord<char*>(element); }

} // namespace

SmBlMemMgr::SmBlMemMgr(std::uint64_t elemSize, std::uint64_t count, std::uint64_t maxCount, std::uint64_t align)
    : elemSize_(roundedUp(elemSize, alignment(align))), align_(alignment(align)) {
    std::uint64_t const n = std::max(count, FEWEST_ELEMENTS);
    firstChunk_ = chunkFor(product(n, elemSize_), LARGEST_FIRST_CHUNK);
    maxChunk_ =
        maxCount >= product(GROWTH, n) ? chunkFor(product(elemSize_, maxCount), LARGEST_CHUNK) : GROWTH * firstChunk_;
    grow();
}

void* SmBlMemMgr::alloc(std::uint64_t size) { return size <= elemSize_ ? SmBlMemMgr::alloc() : nullptr; }

void* SmBlMemMgr::alloc() {
    if (freeList_ != nullptr) [[unlikely]]
        return std::exchange(freeList_, nextOf(freeList_));
    return hasRoom() ? carve() : carveFromNewChunk();
}

void SmBlMemMgr::free(void* p, std::uint64_t) { SmBlMemMgr::free(p); }

void SmBlMemMgr::free(void* p) {
    // Freeing many elements in a row fetches as many cache lines, and the fetches can overlap.
    _mm_prefetch(static_cast<char const*>(p), _MM_HINT_T0);
    if (p == top_) [[likely]] {
        // The same as from `top_`, which was written a moment ago and would have to be waited for.
        top_ = static_cast<char*>(p) + elemSize_;
    } else if (p != nullptr) {
        // kept memory-01: a whole pointer goes into the element, however small that is.
        detail::storeWord(p, freeList_);
        freeList_ = static_cast<char*>(p);
    }
}

void* SmBlMemMgr::carveFromNewChunk() {
    // Elements larger than a chunk need the next sizes too, as long as chunks grow.
    do {
        bool const last = chunks_.size() != 0 && nextChunkSize() < elemSize_ && nextChunkSize() >= maxChunk_;
        if (last || !grow()) return nullptr;
    } while (!hasRoom());
    return carve();
}

std::uint64_t SmBlMemMgr::nextChunkSize() const {
    if (chunks_.size() == 0) return firstChunk_;
    std::uint64_t const newest = chunks_.first()->value.size;
    return newest < maxChunk_ ? 2 * newest : newest;
}

bool SmBlMemMgr::grow() {
    pending_ = makeChunk(nextChunkSize());
    if (pending_ == nullptr) return false;
    LB const& chunk = pending_->value;
    auto const end = reinterpret_cast<std::uintptr_t>(chunk.data) + chunk.size;
    base_ = chunk.data;
    top_ = chunk.data + chunk.size - end % align_;
    chunks_.insertFront(std::exchange(pending_, nullptr));
    return true;
}

bool SmBlMemMgr::isElement(char const* p) const {
    for (Chunks::Unit const* unit = chunks_.first(); unit != nullptr; unit = unit->next) {
        LB const& chunk = unit->value;
        if (p >= chunk.data && p + elemSize_ <= chunk.data + chunk.size) {
            return reinterpret_cast<std::uintptr_t>(p) % align_ == 0 && (unit != chunks_.first() || p >= top_);
        }
    }
    return false;
}

bool SmBlMemMgr::isConsistent() const {
    if (!chunks_.isConsistent() || pending_ != nullptr) return false;
    if (chunks_.size() == 0) return top_ == nullptr && base_ == nullptr && freeList_ == nullptr;
    LB const& current = chunks_.first()->value;
    if (base_ != current.data || top_ < base_ || top_ > base_ + current.size) return false;
    for (char const* element = freeList_; element != nullptr; element = nextOf(element)) {
        if (!isElement(element)) return false;
    }
    return true;
}

} // namespace ZOR_Basis

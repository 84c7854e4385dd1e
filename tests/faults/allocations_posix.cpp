#include "tests/faults/allocations_posix.h"

#include <atomic>
#include <cerrno>
#include <cstddef>

#define ALLOCATES extern "C" [[gnu::visibility("default")]]

// The system's own, under the names by which they are still to be had.
extern "C" {
void* __libc_malloc(std::size_t);
void* __libc_calloc(std::size_t, std::size_t);
void* __libc_realloc(void*, std::size_t);
void* __libc_memalign(std::size_t, std::size_t);
void __libc_free(void*);
}

namespace {

constinit std::atomic<bool> counts{false};
constinit std::atomic<std::uint64_t> made{0};
constinit std::atomic<std::uint64_t> failed{0};
constinit std::atomic<std::uint64_t> firstToFail{0};
constinit std::atomic<std::uint64_t> timesToFail{0};
constinit std::atomic<std::int64_t> blocks{0};

bool isToFail() {
    if (!counts) return false;
    std::uint64_t const number = made.fetch_add(1);
    if (number - firstToFail >= timesToFail) return false;
    ++failed;
    errno = ENOMEM;
    return true;
}

void* counted(void* block) {
    if (block != nullptr) ++blocks;
    return block;
}

} // namespace

ALLOCATES void* malloc(std::size_t size) { return isToFail() ? nullptr : counted(__libc_malloc(size)); }
ALLOCATES void* calloc(std::size_t n, std::size_t size) {
    return isToFail() ? nullptr : counted(__libc_calloc(n, size));
}
ALLOCATES void* realloc(void* old, std::size_t size) {
    if (isToFail()) return nullptr;
    void* const block = __libc_realloc(old, size);
    if (old == nullptr) return counted(block);
    if (block == nullptr && size == 0) --blocks;
    return block;
}
ALLOCATES void* memalign(std::size_t alignment, std::size_t size) {
    return isToFail() ? nullptr : counted(__libc_memalign(alignment, size));
}
ALLOCATES void* aligned_alloc(std::size_t alignment, std::size_t size) { return memalign(alignment, size); }
ALLOCATES int posix_memalign(void** block, std::size_t alignment, std::size_t size) {
    *block = memalign(alignment, size);
    return *block != nullptr ? 0 : ENOMEM;
}
ALLOCATES void free(void* block) {
    if (block == nullptr) return;
    --blocks;
    __libc_free(block);
}

namespace allocations {

void failFrom(std::uint64_t first, std::uint64_t times) {
    made = 0;
    failed = 0;
    firstToFail = first;
    timesToFail = times;
    counts = true;
}
std::uint64_t stopFailing() {
    counts = false;
    return made;
}
std::uint64_t failures() { return failed; }
std::int64_t living() { return blocks; }

} // namespace allocations

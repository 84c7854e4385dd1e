// Lists that are sorted while memory is short, for Linux; the Windows build has the same code.

#include "tests/containers/sng_list_steps.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstddef>

extern "C" void* __libc_malloc(std::size_t size);

namespace {

/// How many allocations of this thread have been refused; below 0: none is.
thread_local int refused = -1;

} // namespace

/// Stands in for the system's own.
extern "C" [[gnu::visibility("default")]] void* malloc(std::size_t size) noexcept {
    if (refused < 0) return __libc_malloc(size);
    ++refused;
    errno = ENOMEM;
    return nullptr;
}

TEST(SngListMemoryPosix, is_sorted_alike_without_memory) {
    sng_list::ListBesideVector<std::mt19937_64> both(randomSource());
    for (int round = 0; round < 500; ++round) {
        both.list.clear();
        both.items.clear();
        for (std::uint64_t n = 3 + both.below(40); n > 0; --n) {
            sng_list::Items::value_type const item = both.item();
            both.list.insertBack(item);
            both.items.push_back(item);
        }
        bool const isAscending = both.below(2) == 0;
        sng_list::sortLikeList(both.items, isAscending);
        refused = 0;
        both.list.sort(isAscending);
        int const asked = refused;
        refused = -1;
        ASSERT_GT(asked, 0) << "it does without memory only if there is none";
        ASSERT_TRUE(both.agree()) << round;
        ASSERT_EQ(both.list.last()->value.tag, both.items.back().tag);
    }
}

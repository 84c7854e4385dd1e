#include "host/xos_basics/semaphores/semaphore.h"

#include <gtest/gtest.h>

#include <set>
#include <thread>
#include <vector>

namespace {

using host::Semaphore;
using host::SemaphoreKind;

Semaphore* make() { return host::makeSemaphore(SemaphoreKind::BINARY, host::WORD_FREE); }

TEST(HostSemaphorePool, gives_a_block_in_its_first_state_with_a_handle_that_finds_it) {
    for (SemaphoreKind const kind : {SemaphoreKind::MUTEX, SemaphoreKind::BINARY, SemaphoreKind::NAMED}) {
        for (std::uint32_t const state : {host::WORD_FREE, host::WORD_HELD}) {
            Semaphore* const semaphore = host::makeSemaphore(kind, state);
            ASSERT_NE(semaphore, nullptr);
            EXPECT_EQ(semaphore->kind, kind);
            EXPECT_EQ(semaphore->lock.held, state);
            EXPECT_EQ(semaphore->owner, 0u);
            EXPECT_EQ(semaphore->depth, 0u);
            EXPECT_EQ(host::semaphoreOf(semaphore->handle), semaphore);
            // Whatever its user left in it.
            semaphore->owner = 7;
            semaphore->depth = 3;
            host::freeSemaphore(semaphore);
        }
    }
}

TEST(HostSemaphorePool, tells_a_handle_that_ended_from_the_one_that_uses_its_block_now) {
    Semaphore* const first = make();
    xos_Sem const ended = first->handle;
    host::freeSemaphore(first);
    EXPECT_EQ(host::semaphoreOf(ended), nullptr);
    Semaphore* const second = make();
    EXPECT_EQ(second, first) << "the block is used again";
    EXPECT_NE(second->handle, ended);
    EXPECT_EQ(host::semaphoreOf(ended), nullptr);
    host::freeSemaphore(second);
}

TEST(HostSemaphorePool, gives_different_blocks_and_takes_them_back_from_any_thread) {
    std::vector<Semaphore*> made;
    std::thread([&] {
        for (int i = 0; i < 100; ++i) { made.push_back(make()); }
    }).join();
    std::set<Semaphore*> const different(made.begin(), made.end());
    EXPECT_EQ(different.size(), made.size());
    for (Semaphore* const semaphore : made) { host::freeSemaphore(semaphore); }
}

TEST(HostSemaphorePool, gets_the_blocks_back_that_a_thread_had_at_hand) {
    std::set<Semaphore*> blocks;
    for (int i = 0; i < 200; ++i) {
        std::thread([&] {
            Semaphore* const semaphore = make();
            blocks.insert(semaphore);
            host::freeSemaphore(semaphore);
        }).join();
    }
    EXPECT_LT(blocks.size(), 64u) << "each thread makes blocks of its own";
}

} // namespace

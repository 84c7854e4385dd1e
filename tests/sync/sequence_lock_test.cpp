#include "basis/sync/sequence_lock.h"

#include "tests/sync/gated_job.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

using namespace ZOR_Basis;

TEST(SequenceLock, tells_readers_whether_somebody_has_written_meanwhile) {
    SequenceLock lock;
    std::uint32_t const before = lock.beginReading();
    EXPECT_TRUE(lock.isUnchanged(before));
    EXPECT_TRUE(lock.isUnchanged(before)) << "asking changes nothing";
    EXPECT_EQ(lock.beginReading(), before);
    lock.beginWriting();
    EXPECT_FALSE(lock.isUnchanged(before)) << "while it is written";
    lock.endWriting();
    EXPECT_FALSE(lock.isUnchanged(before)) << "after it was written";
    std::uint32_t const after = lock.beginReading();
    EXPECT_TRUE(lock.isUnchanged(after));
    lock.beginWriting();
    lock.endWriting();
    EXPECT_FALSE(lock.isUnchanged(after));
    EXPECT_FALSE(lock.isUnchanged(before)) << "nor does it look as it did two writers ago";
}

TEST(SequenceLock, lets_no_reader_begin_while_somebody_writes) {
    SequenceLock lock;
    lock.beginWriting();
    std::atomic<bool> begun{false};
    std::thread reader([&] {
        lock.beginReading();
        begun = true;
    });
    EXPECT_TRUE(notInAMoment([&] { return begun.load(); }));
    lock.endWriting();
    reader.join();
    EXPECT_TRUE(begun);
}

TEST(SequenceLock, comes_to_rest_after_two_writers_at_a_time) {
    SequenceLock lock;
    std::uint32_t const before = lock.beginReading();
    lock.beginWriting();
    lock.beginWriting();
    lock.endWriting();
    lock.endWriting();
    std::uint32_t const after = lock.beginReading();
    EXPECT_NE(after, before);
    EXPECT_TRUE(lock.isUnchanged(after));
}

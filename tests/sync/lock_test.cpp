#include <zor_basis/sync/lock.h>

#include <xos_host.h>

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <thread>

using namespace ZOR_Basis;

namespace {

class LockOfAType : public testing::Test {
protected:
    ~LockOfAType() override { xos_HostFailClear(); }
};

/// Whether another thread gets the lock within a moment; it gives it back.
class Waiter {
public:
    explicit Waiter(Lock& lock)
        : thread_([this, &lock] {
              lock.lock();
              got_ = true;
              lock.unlock();
          }) {}
    ~Waiter() { thread_.join(); }
    bool hasIt() {
        for (int i = 0; i < 30 && !got_; ++i) std::this_thread::sleep_for(std::chrono::milliseconds(1));
        return got_;
    }

private:
    std::atomic<bool> got_{false};
    std::thread thread_;
};

} // namespace

TEST_F(LockOfAType, breathes) {
    for (Lock::Type type : {Lock::Binary, Lock::Mutex}) {
        Lock lock(type, false);
        lock.lock();
        Waiter waiter(lock);
        EXPECT_FALSE(waiter.hasIt());
        lock.unlock();
        EXPECT_TRUE(waiter.hasIt());
    }
}

TEST_F(LockOfAType, makes_the_semaphore_of_its_type) {
    struct Case {
        Row row;
        std::uint32_t type;
        bool locked;
        std::uint64_t binaries, mutexes, takes;
        char const* available;
    };
    for (Case const& c : {
             Case{{}, 0, false, 1, 0, 0, "1"}, Case{{}, 0, true, 1, 0, 0, "0"}, Case{{}, 1, false, 0, 1, 0, nullptr},
             Case{{}, 1, true, 0, 1, 1, nullptr}, Case{{}, 77, true, 0, 1, 1, nullptr}, // every other value is a mutex
         }) {
        SCOPED_TRACE(c.row);
        xos_HostCallsReset();
        { Lock const lock(static_cast<Lock::Type>(c.type), c.locked); }
        EXPECT_EQ(xos_HostCalls("xos_SemBCreate"), c.binaries);
        EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), c.mutexes);
        EXPECT_EQ(xos_HostCalls("xos_SemTake"), c.takes);
        EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u) << "held or not";
        EXPECT_STREQ(xos_HostLastCall("xos_SemBCreate"), c.available);
    }
}

TEST_F(LockOfAType, that_begins_locked_keeps_others_out) {
    for (Lock::Type type : {Lock::Binary, Lock::Mutex}) {
        Lock lock(type, true);
        Waiter waiter(lock);
        EXPECT_FALSE(waiter.hasIt());
        lock.unlock();
        EXPECT_TRUE(waiter.hasIt());
    }
}

TEST_F(LockOfAType, as_a_mutex_may_be_locked_again_by_its_thread) {
    Lock lock(Lock::Mutex, true);
    lock.lock();
    lock.unlock();
    Waiter waiter(lock);
    EXPECT_FALSE(waiter.hasIt());
    lock.unlock();
    EXPECT_TRUE(waiter.hasIt());
}

TEST_F(LockOfAType, as_a_binary_may_be_unlocked_by_any_thread) {
    Lock lock(Lock::Binary, true);
    std::thread([&lock] { lock.unlock(); }).join();
    lock.lock();
    lock.unlock();
    lock.unlock(); // stays available, once
    lock.lock();
    Waiter waiter(lock);
    EXPECT_FALSE(waiter.hasIt());
    lock.unlock();
}

TEST_F(LockOfAType, that_could_not_be_made_locks_nothing) {
    xos_HostFail("xos_SemMCreate", 0, 1);
    xos_HostFail("xos_SemBCreate", 0, 1);
    Lock mutex(Lock::Mutex, true);
    Lock binary(Lock::Binary, true);
    mutex.lock();
    mutex.unlock();
    binary.lock();
    binary.unlock();
}

TEST_F(LockOfAType, Kept_sync_01_assigning_shares_the_semaphore) {
    Lock first(Lock::Binary, true);
    xos_HostCallsReset();
    {
        Lock second(Lock::Binary, false);
        second = first;
        second.unlock();
        first.lock(); // the same semaphore
    }
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    xos_HostFail("xos_SemDestroy", 0, 1); // the second destruction of the same one
}

#include "tests/faults/scenario.h"

#include <zor_basis/sync.h>

#include <memory>
#include <thread>

using namespace ZOR_Basis;

namespace {

bool succeed(void*) { return true; }

bool locks(Place const&) {
    Lock lock(Lock::Mutex, false);
    lock.lock();
    lock.unlock();
    Lock const held(Lock::Mutex, true);
    return true;
}
bool locksKeys(Place const&) {
    SemSet const set(3);
    if (set.operator->() == nullptr) return false;
    for (std::uint64_t key = 0; key < 10; ++key) {
        if (!set->take(key)) return false;
    }
    bool isGiven = true;
    for (std::uint64_t key = 0; key < 10; ++key) isGiven = set->give(key) && isGiven;
    return isGiven;
}
bool queues(Place const&) {
    std::unique_ptr<MultiTaskQueue> const queue(MultiTaskQueue::New(MultiTaskQueue::StopOnError, 2));
    if (queue == nullptr) return false;
    bool isWhole = true;
    for (int i = 0; i < 4; ++i) isWhole = queue->add(succeed, nullptr, false, true, false) && isWhole;
    // A job without a task counts as running forever, so that `wait` would not return.
    for (MTQ_Dat const* job = queue->first(); job != nullptr; job = queue->next()) {
        while (!job->finished()) std::this_thread::yield();
    }
    if (isWhole) queue->wait();
    return isWhole && !queue->failed();
}

} // namespace

Scenarios threadScenarios() {
    return {
        {"Lock", prepareNothing, locks},
        {"SemSet", prepareNothing, locksKeys},
        {"MultiTaskQueue", prepareNothing, queues},
    };
}

/// \file
/// A job that runs until a test opens its gate, and returns what the test wants.

#ifndef TESTS_SYNC_GATED_JOB_H
#define TESTS_SYNC_GATED_JOB_H

#include "tests/support/wait_for.h"

#include <zor_basis/sync.h>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <thread>

/// Watches something for a moment. \return whether it never became true
template <class Try>
bool notInAMoment(Try const& attempt) {
    for (int i = 0; i < 30; ++i) {
        if (attempt()) return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return true;
}

class GatedJob : public ZOR_Basis::MTQ_Arg {
public:
    explicit GatedJob(std::atomic<int>* deletions = nullptr) : deletions_(deletions) {}
    ~GatedJob() override {
        if (deletions_ != nullptr) ++*deletions_;
    }
    GatedJob(GatedJob const&) = delete;
    GatedJob& operator=(GatedJob const&) = delete;

    void open(bool result = true) {
        std::lock_guard const held(mutex_);
        result_ = result;
        isOpen_ = true;
        opened_.notify_all();
    }
    bool runs() const { return runs_; }

    static bool run(void* argument) {
        auto& job = *static_cast<GatedJob*>(static_cast<MTQ_Arg*>(argument));
        job.runs_ = true;
        std::unique_lock held(job.mutex_);
        job.opened_.wait(held, [&] { return job.isOpen_; });
        return job.result_;
    }
    /// As an argument of a queue.
    void* argument() { return static_cast<MTQ_Arg*>(this); }

private:
    std::atomic<int>* const deletions_;
    std::atomic<bool> runs_{false};
    std::mutex mutex_;
    std::condition_variable opened_;
    bool isOpen_ = false;
    bool result_ = false;
};

#endif

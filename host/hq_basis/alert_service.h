/// \file
/// The alerts of the process: one thread that knows when they are due, and workers that run them.
///
/// Every due alert gets a worker of its own: an idle one, else a new one. So a callback that never returns costs a
/// thread and delays no other. An alert is never run twice at the same time.

#ifndef HOST_HQ_BASIS_ALERT_SERVICE_H
#define HOST_HQ_BASIS_ALERT_SERVICE_H

#include "basis/platform/hq_basis.h"

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <deque>
#include <map>
#include <memory>
#include <mutex>
#include <set>
#include <thread>
#include <utility>

namespace host {

class AlertService {
public:
    /// The one service; never destroyed, as its threads run until the process is gone.
    static AlertService& instance();

    /// \return the alert's id; 0: no thread could be had
    std::uint32_t add(std::uint32_t periodMs, HQ_Basis::AlertTimer::Callback callback, void* context);

    /// Waits for a callback that runs on another thread, at most `LONGEST_WAIT`.
    void remove(std::uint32_t id);

    /// Runs an alert on the calling thread.
    /// \return false: there is none, or it is the one that calls this
    bool fire(std::uint32_t id);

    static constexpr std::chrono::milliseconds LONGEST_WAIT{1000};

private:
    using Clock = std::chrono::steady_clock;

    struct Alert {
        HQ_Basis::AlertTimer::Alert shown;
        HQ_Basis::AlertTimer::Callback callback;
        Clock::time_point due;
        /// The thread that runs the callback now; a default id: none does.
        std::thread::id runner;
        bool isQueued{false};
        bool isRemoved{false};
    };
    using AlertPointer = std::shared_ptr<Alert>;
    using Lock = std::unique_lock<std::mutex>;

    static Clock::time_point dueAfter(std::uint32_t periodMs);

    bool startScheduler();
    void startWorker();
    void schedule();
    void queueDue();
    void work();
    void run(Lock& lock, AlertPointer const& alert);
    std::uint32_t freeId();
    void plan(AlertPointer const& alert, Clock::time_point due);
    void unplan(AlertPointer const& alert);

    std::mutex mutex_;
    std::condition_variable scheduleChanged_;
    std::condition_variable workArrived_;
    std::condition_variable callbackReturned_;
    std::map<std::uint32_t, AlertPointer> alerts_;
    /// The alerts that wait for their time, earliest first.
    std::set<std::pair<Clock::time_point, std::uint32_t>> plan_;
    /// The alerts that wait for a worker.
    std::deque<AlertPointer> queue_;
    std::uint32_t lastId_{0};
    unsigned idleWorkers_{0};
    bool schedulerRuns_{false};
};

} // namespace host

#endif

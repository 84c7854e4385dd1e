#include "host/hq_basis/alert_service.h"

#include <algorithm>
#include <exception>
#include <new>
#include <system_error>

namespace host {

namespace {

/// More idle workers than these end.
constexpr unsigned MOST_IDLE = 4;

} // namespace

AlertService& AlertService::instance() {
    static auto& service = *new AlertService;
    return service;
}

AlertService::Clock::time_point AlertService::dueAfter(std::uint32_t periodMs) {
    // Without a rest an alert would keep a processor busy.
    return Clock::now() + std::chrono::milliseconds{std::max<std::uint32_t>(periodMs, 1)};
}

std::uint32_t AlertService::add(std::uint32_t periodMs, HQ_Basis::AlertTimer::Callback callback, void* context) {
    Lock const lock{mutex_};
    if (!startScheduler()) return 0;
    auto const alert = std::make_shared<Alert>();
    alert->shown = {freeId(), context};
    alert->callback = callback;
    auto const place = alerts_.emplace(alert->shown.id, alert).first;
    try {
        plan(alert, dueAfter(periodMs));
    } catch (std::bad_alloc const&) {
        alerts_.erase(place);
        throw;
    }
    return alert->shown.id;
}

void AlertService::remove(std::uint32_t id) {
    Lock lock{mutex_};
    auto const found = alerts_.find(id);
    if (found == alerts_.end()) return;
    AlertPointer const alert = found->second;
    alert->isRemoved = true;
    alerts_.erase(found);
    unplan(alert);
    callbackReturned_.notify_all(); // for those who wait to fire it
    if (alert->runner != std::this_thread::get_id()) {
        callbackReturned_.wait_for(lock, LONGEST_WAIT, [&] { return alert->runner == std::thread::id{}; });
    }
}

bool AlertService::fire(std::uint32_t id) {
    Lock lock{mutex_};
    auto const found = alerts_.find(id);
    if (found == alerts_.end() || found->second->runner == std::this_thread::get_id()) return false;
    AlertPointer const alert = found->second;
    callbackReturned_.wait(lock, [&] { return alert->runner == std::thread::id{} || alert->isRemoved; });
    if (alert->isRemoved) return false;
    unplan(alert);
    run(lock, alert);
    return true;
}

std::uint32_t AlertService::freeId() {
    do { ++lastId_; } while (lastId_ == 0 || alerts_.count(lastId_) != 0);
    return lastId_;
}

void AlertService::plan(AlertPointer const& alert, Clock::time_point due) {
    alert->due = due;
    plan_.emplace(due, alert->shown.id);
    scheduleChanged_.notify_one();
}

void AlertService::unplan(AlertPointer const& alert) {
    plan_.erase({alert->due, alert->shown.id});
    if (alert->isQueued) {
        queue_.erase(std::find(queue_.begin(), queue_.end(), alert));
        alert->isQueued = false;
    }
}

bool AlertService::startScheduler() {
    if (schedulerRuns_) return true;
    try {
        std::thread([this] { schedule(); }).detach();
        schedulerRuns_ = true;
    } catch (std::system_error const&) { return false; }
    return true;
}

void AlertService::startWorker() {
    try {
        std::thread([this] { work(); }).detach();
    } catch (std::exception const&) { // neither a thread nor memory for it
        // The alert waits in the queue for the next worker that is free.
    }
}

void AlertService::schedule() {
    Lock lock{mutex_};
    for (;;) {
        queueDue();
        if (plan_.empty()) {
            scheduleChanged_.wait(lock);
        } else {
            Clock::time_point const next = plan_.begin()->first;
            scheduleChanged_.wait_until(lock, next);
        }
    }
}

void AlertService::queueDue() {
    Clock::time_point const now = Clock::now();
    while (!plan_.empty() && plan_.begin()->first <= now) {
        AlertPointer const alert = alerts_.at(plan_.begin()->second);
        plan_.erase(plan_.begin());
        alert->isQueued = true;
        queue_.push_back(alert);
        if (idleWorkers_ < queue_.size()) startWorker();
        workArrived_.notify_one();
    }
}

void AlertService::work() {
    Lock lock{mutex_};
    for (;;) {
        while (!queue_.empty()) {
            AlertPointer const alert = queue_.front();
            queue_.pop_front();
            alert->isQueued = false;
            run(lock, alert);
        }
        if (idleWorkers_ >= MOST_IDLE) return;
        ++idleWorkers_;
        workArrived_.wait(lock);
        --idleWorkers_;
    }
}

void AlertService::run(Lock& lock, AlertPointer const& alert) {
    alert->runner = std::this_thread::get_id();
    lock.unlock();
    std::uint32_t const nextPeriodMs = alert->callback(alert->shown);
    lock.lock();
    alert->runner = {};
    if (!alert->isRemoved) plan(alert, dueAfter(nextPeriodMs));
    callbackReturned_.notify_all();
}

} // namespace host

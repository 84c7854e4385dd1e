#include "host/hq_basis/alert_service.h"

#include <algorithm>
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
    Lock const lock{_mutex};
    if (!startScheduler()) { return 0; }
    auto const alert = std::make_shared<Alert>();
    alert->shown = {freeId(), context};
    alert->callback = callback;
    _alerts.emplace(alert->shown.id, alert);
    plan(alert, dueAfter(periodMs));
    return alert->shown.id;
}

void AlertService::remove(std::uint32_t id) {
    Lock lock{_mutex};
    auto const found = _alerts.find(id);
    if (found == _alerts.end()) { return; }
    AlertPointer const alert = found->second;
    alert->isRemoved = true;
    _alerts.erase(found);
    unplan(alert);
    _callbackReturned.notify_all(); // for those who wait to fire it
    if (alert->runner != std::this_thread::get_id()) {
        _callbackReturned.wait_for(lock, LONGEST_WAIT, [&] { return alert->runner == std::thread::id{}; });
    }
}

bool AlertService::fire(std::uint32_t id) {
    Lock lock{_mutex};
    auto const found = _alerts.find(id);
    if (found == _alerts.end() || found->second->runner == std::this_thread::get_id()) { return false; }
    AlertPointer const alert = found->second;
    _callbackReturned.wait(lock, [&] { return alert->runner == std::thread::id{} || alert->isRemoved; });
    if (alert->isRemoved) { return false; }
    unplan(alert);
    run(lock, alert);
    return true;
}

std::uint32_t AlertService::freeId() {
    do { ++_lastId; } while (_lastId == 0 || _alerts.count(_lastId) != 0);
    return _lastId;
}

void AlertService::plan(AlertPointer const& alert, Clock::time_point due) {
    alert->due = due;
    _plan.emplace(due, alert->shown.id);
    _scheduleChanged.notify_one();
}

void AlertService::unplan(AlertPointer const& alert) {
    _plan.erase({alert->due, alert->shown.id});
    if (alert->isQueued) {
        _queue.erase(std::find(_queue.begin(), _queue.end(), alert));
        alert->isQueued = false;
    }
}

bool AlertService::startScheduler() {
    if (_schedulerRuns) { return true; }
    try {
        std::thread([this] { schedule(); }).detach();
        _schedulerRuns = true;
    } catch (std::system_error const&) { return false; }
    return true;
}

void AlertService::startWorker() {
    try {
        std::thread([this] { work(); }).detach();
    } catch (std::system_error const&) {
        // The alert waits in the queue for the next worker that is free.
    }
}

void AlertService::schedule() {
    Lock lock{_mutex};
    for (;;) {
        queueDue();
        if (_plan.empty()) {
            _scheduleChanged.wait(lock);
        } else {
            Clock::time_point const next = _plan.begin()->first;
            _scheduleChanged.wait_until(lock, next);
        }
    }
}

void AlertService::queueDue() {
    Clock::time_point const now = Clock::now();
    while (!_plan.empty() && _plan.begin()->first <= now) {
        AlertPointer const alert = _alerts.at(_plan.begin()->second);
        _plan.erase(_plan.begin());
        alert->isQueued = true;
        _queue.push_back(alert);
        if (_idleWorkers < _queue.size()) { startWorker(); }
        _workArrived.notify_one();
    }
}

void AlertService::work() {
    Lock lock{_mutex};
    for (;;) {
        while (!_queue.empty()) {
            AlertPointer const alert = _queue.front();
            _queue.pop_front();
            alert->isQueued = false;
            run(lock, alert);
        }
        if (_idleWorkers >= MOST_IDLE) { return; }
        ++_idleWorkers;
        _workArrived.wait(lock);
        --_idleWorkers;
    }
}

void AlertService::run(Lock& lock, AlertPointer const& alert) {
    alert->runner = std::this_thread::get_id();
    lock.unlock();
    std::uint32_t const nextPeriodMs = alert->callback(alert->shown);
    lock.lock();
    alert->runner = {};
    if (!alert->isRemoved) { plan(alert, dueAfter(nextPeriodMs)); }
    _callbackReturned.notify_all();
}

} // namespace host

#include "zor_basis/timers/pile_timer.h"

#include "basis/ground/clock.h"
#include "basis/timers/complaint.h"
#include "basis/timers/measurement.h"
#include "basis/timers/report_row.h"

namespace ZOR_Basis {
namespace {

constexpr int LINE_START = 183;
constexpr int LINE_STOP = 190;
constexpr int LINE_SUSPEND = 197;
constexpr int LINE_RESUME = 204;

} // namespace

// Stands here because it needs the pile, which is derived from this class: beside its class, the two sources would need
// each other.
void BaseTimer::stop(PileTimer* pile) {
    if (zbTimerDat::start == 0) return;
    Measurement::finish(*this);
    if (pile != nullptr) pile->addTotal(*this);
    // kept timers-01: the record is idle whatever became of the measurement.
    reset();
}

PileTimer::PileTimer(char const* name, bool checks) : checks_(checks), name_(name) {}

PileTimer::~PileTimer() = default;

void PileTimer::lock() {}
void PileTimer::unlock() {}

void PileTimer::start(bool beginSuspended) {
    if (checks_ && started()) complain(LINE_START, "PileTimer::start() : already started");
    Measurement::start(*this, beginSuspended);
}

void PileTimer::suspend() {
    if (!isSuspended()) {
        suspendStart = PerformanceCounter::now();
    } else if (checks_) {
        complain(LINE_SUSPEND, "PileTimer::suspend() : already suspended");
    }
}

void PileTimer::resume() {
    if (checks_ && !isSuspended()) complain(LINE_RESUME, "PileTimer::resume() : not suspended");
    Measurement::resume(*this);
}

void PileTimer::stop() {
    // kept timers-04: the message says "start()".
    if (checks_ && !started()) complain(LINE_STOP, "PileTimer::start() : not started");
    BaseTimer::stop(this);
}

void PileTimer::addTotal(BaseTimer& finished) {
    if (!finished.started()) return;
    std::int64_t const elapsed = finished.BaseTimer::total();
    std::int64_t const suspension = finished.BaseTimer::suspended();
    finished.BaseTimer::reset();
    lock();
    std::uint64_t const ordinal = count_ + 1;
    count_ = ordinal;
    if (elapsed > max_) {
        max_ = elapsed;
        maxCount_ = ordinal;
    }
    // kept timers-05: 0 stands for "none yet".
    if (min_ == 0 || elapsed < min_) {
        min_ = elapsed;
        minCount_ = ordinal;
    }
    total_ = total_ + elapsed;
    if (suspension != 0) {
        suspendTotal_ = suspendTotal_ + suspension;
        if (suspension > suspendMax_) suspendMax_ = suspension;
    }
    unlock();
}

void PileTimer::reset() {
    BaseTimer::reset();
    total_ = suspendTotal_ = max_ = min_ = suspendMax_ = 0;
    count_ = maxCount_ = minCount_ = 0;
}

void PileTimer::print(BufStr<255>& line, int unitsPerSecond) const {
    ReportRow::Values values;
    values.count = static_cast<std::int64_t>(count_);
    // One reading of the count decides: a reset meanwhile must not leave a division by 0.
    if (values.count != 0) {
        auto const convert = [unitsPerSecond](std::int64_t ticks) {
            return ReportRow::convert(ticks, unitsPerSecond, _freq);
        };
        values.total = convert(total_);
        values.average = values.total / values.count;
        values.maximum = convert(max_);
        values.maximumCount = static_cast<std::int64_t>(maxCount_);
        values.minimum = convert(min_);
        values.suspendTotal = convert(suspendTotal_);
        values.suspendMaximum = convert(suspendMax_);
    }
    ReportRow::format(line, name_, values);
}

void PileTimer::start(PileTimer* timer, bool beginSuspended) {
    if (timer != nullptr) timer->start(beginSuspended);
}
void PileTimer::stop(PileTimer* timer) {
    if (timer != nullptr) timer->stop();
}
void PileTimer::suspend(PileTimer* timer) {
    if (timer != nullptr) timer->suspend();
}
void PileTimer::resume(PileTimer* timer) {
    if (timer != nullptr) timer->resume();
}
void PileTimer::reset(PileTimer* timer) {
    if (timer != nullptr) timer->reset();
}

} // namespace ZOR_Basis

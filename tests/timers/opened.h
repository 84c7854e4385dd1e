/// \file
/// Timers whose numbers can be seen, and measurements that took as long as a test wants.

#ifndef TESTS_TIMERS_OPENED_H
#define TESTS_TIMERS_OPENED_H

#include <zor_basis/timers.h>

#include <array>
#include <cstdint>

/// A pile with its statistics laid open.
template <class Pile>
class Opened : public Pile {
public:
    using Pile::Pile;

    /// count, total, max, maxCount, min, minCount, suspendTotal, suspendMax
    std::array<std::int64_t, 8> numbers() const {
        return {static_cast<std::int64_t>(this->count_),
                this->total_,
                this->max_,
                static_cast<std::int64_t>(this->maxCount_),
                this->min_,
                static_cast<std::int64_t>(this->minCount_),
                this->suspendTotal_,
                this->suspendMax_};
    }
    static std::int64_t frequency() { return Pile::_freq; }
};

using OpenedPile = Opened<ZOR_Basis::PileTimer>;

/// A finished measurement, ready for `addTotal`.
inline ZOR_Basis::BaseTimer finished(std::int64_t elapsed, std::int64_t suspended = 0) {
    ZOR_Basis::BaseTimer timer;
    static_cast<zbTimerDat&>(timer) = {1000, 1000 + elapsed, 0, suspended};
    return timer;
}

inline void pileUp(ZOR_Basis::PileTimer& pile, std::int64_t elapsed, std::int64_t suspended = 0) {
    ZOR_Basis::BaseTimer timer = finished(elapsed, suspended);
    pile.addTotal(timer);
}

inline bool isIdle(zbTimerDat const& record) {
    return record.start == 0 && record.stop == 0 && record.suspendStart == 0 && record.suspended == 0;
}

/// Waits until the counter has moved. \return a reading after that
inline std::int64_t nextTick() {
    std::int64_t const before = ZOR_Basis::BaseTimer::Clock();
    std::int64_t now = before;
    while (now == before) now = ZOR_Basis::BaseTimer::Clock();
    return now;
}

#endif

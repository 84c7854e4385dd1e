/// \file
/// Timers with visible statistics, and measurements of any length.

#ifndef TESTS_TIMERS_OPENED_H
#define TESTS_TIMERS_OPENED_H

#include <zor_basis/timers.h>

#include <cstdint>
#include <ostream>
#include <string>

/// What a pile has counted. Times are in ticks; `maxCount` and `minCount` tell which measurement was the longest and
/// which the shortest, from 1 on.
struct Statistics {
    std::int64_t count = 0;
    std::int64_t total = 0;
    std::int64_t max = 0;
    std::int64_t maxCount = 0;
    std::int64_t min = 0;
    std::int64_t minCount = 0;
    std::int64_t suspendTotal = 0;
    std::int64_t suspendMax = 0;

    bool operator==(Statistics const&) const = default;
};

inline std::ostream& operator<<(std::ostream& out, Statistics const& s) {
    return out << "count " << s.count << ", total " << s.total << ", max " << s.max << " (" << s.maxCount << "), min "
               << s.min << " (" << s.minCount << "), suspend total " << s.suspendTotal << ", suspend max "
               << s.suspendMax;
}

/// A pile with visible statistics.
template <class Pile>
class Opened : public Pile {
public:
    using Pile::Pile;

    Statistics statistics() const {
        return {.count = static_cast<std::int64_t>(this->count_),
                .total = this->total_,
                .max = this->max_,
                .maxCount = static_cast<std::int64_t>(this->maxCount_),
                .min = this->min_,
                .minCount = static_cast<std::int64_t>(this->minCount_),
                .suspendTotal = this->suspendTotal_,
                .suspendMax = this->suspendMax_};
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

/// The number of measurements in the timer's row.
inline std::string countOf(ZOR_Basis::PileTimer* timer) {
    ZOR_Basis::BufStr<255> line;
    timer->print(line, 1);
    std::string const text(line.c_str() + 40, 9);
    return text.substr(text.find_last_of(' ') + 1);
}

inline bool isIdle(zbTimerDat const& record) {
    return record.start == 0 && record.stop == 0 && record.suspendStart == 0 && record.suspended == 0;
}

/// Waits until the counter advances. \return its new value
inline std::int64_t nextTick() {
    std::int64_t const before = ZOR_Basis::BaseTimer::Clock();
    std::int64_t now = before;
    while (now == before) now = ZOR_Basis::BaseTimer::Clock();
    return now;
}

#endif

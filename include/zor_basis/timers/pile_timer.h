/// \file
/// `PileTimer`: measures the time that a named piece of work takes. It has a measurement of its own and keeps
/// statistics of finished ones: their number, sum, maximum and minimum, and how long they were suspended.
///
/// If the timer's checks are on, misuse of its own measurement is reported through `xos_Assert`, with the tag
/// "zor_basis"; the operation then continues:
///
/// | operation | condition | line | message |
/// |---|---|---|---|
/// | `start` | started already | 183 | "PileTimer::start() : already started" |
/// | `stop` | not started | 190 | "PileTimer::start() : not started" |
/// | `suspend` | suspended already | 197 | "PileTimer::suspend() : already suspended" |
/// | `resume` | not suspended | 204 | "PileTimer::resume() : not suspended" |
///
/// \kept timers-04: the message of `stop` names `start()`, because existing log searches expect that text
/// \thread one thread at a time; a report may read and reset the statistics concurrently. `PileTimerMT` says what
///     threads may share

#ifndef ZOR_BASIS_TIMERS_PILE_TIMER_H
#define ZOR_BASIS_TIMERS_PILE_TIMER_H

#include "zor_basis/export.h"
#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/heap_str.h"
#include "zor_basis/timers/base_timer.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

namespace detail {

/// A number that one thread changes while others read or clear it. A change is a read followed by a write, not an
/// atomic exchange: a clear between the two is lost.
template <class T>
class Statistic {
public:
    Statistic() = default;
    Statistic(Statistic const& other) : value_(other) {}
    Statistic& operator=(Statistic const& other) { return *this = static_cast<T>(other); }
    Statistic& operator=(T value) {
        value_.store(value, std::memory_order_relaxed);
        return *this;
    }
    operator T() const { return value_.load(std::memory_order_relaxed); }

private:
    std::atomic<T> value_{0};
};

} // namespace detail

ZB_INLINE_PARTS_BEGIN
class ZB_API PileTimer : public BaseTimer {
public:
    /// \param name  is copied; null counts as the empty name
    /// \param checks  says whether misuse is reported
    PileTimer(char const* name, bool checks);
    /// Copies all members: the measurement, the statistics, id, checks and name.
    PileTimer(PileTimer const&) = default;
    PileTimer& operator=(PileTimer const&) = default;
    virtual ~PileTimer();

    /// The name, which the timer owns.
    Str const& name() const { return name_; }
    char const* cname() const { return name_.c_str(); }
    /// The slot in the timer's manager; 0 until a manager assigns one.
    std::uint64_t id() const { return id_; }
    void setId(std::uint64_t id) { id_ = id; }
    /// Tells whether the names are equal; nothing else is compared.
    bool eq(PileTimer const& other) const { return name() == other.name(); }

    /// Starts the timer's own measurement; a running one keeps its start.
    /// \param beginSuspended  then suspends the timer, unless it is suspended
    /// \error the timer has already started: see above
    void start(bool beginSuspended);
    /// Opens a suspension, also before the start.
    /// \error a suspension is open: see above; it continues
    void suspend();
    /// Ends the open suspension.
    /// \error no suspension is open: see above
    void resume();
    /// Ends the timer's own measurement and adds it to the statistics.
    /// \error the timer has not started: see above; nothing is added
    void stop();
    /// Adds a finished measurement to the statistics and makes it idle. A measurement that was not started is ignored.
    /// Of equal measurements the first remains the longest or the shortest.
    /// \kept timers-05: a minimum of 0 ticks counts as "none yet", so the next measurement replaces it
    /// \pre the measurement was stopped; otherwise its elapsed time is negative
    void addTotal(BaseTimer& finished);
    /// Clears the timer's own measurement and all statistics; id, checks and name stay.
    void reset();

    /// Formats one row of a report.
    ///
    /// | column | value | last digit at |
    /// |---|---|---|
    /// | 0 | name, from the left | |
    /// | 40 | count | 48 |
    /// | 50 | total | 63 |
    /// | 65 | average: converted total divided by count | 78 |
    /// | 80 | maximum | 93 |
    /// | 95 | number of the longest measurement, from 1 | 108 |
    /// | 110 | minimum | 123 |
    /// | 125 | suspended in total | 138 |
    /// | 140 | suspended at most, in one measurement | 153 |
    /// | 155 | empty | |
    ///
    /// Digits are grouped by three (`thousandsSeparator`). If the count is 0, the row has only name and count.
    /// \param line  receives the row, always 156 bytes
    /// \param unitsPerSecond  sets the unit of durations: 1000000 for microseconds; fractions are cut off
    /// \kept timers-06: a row whose count is not 0 has a zero byte at column 154
    /// \kept timers-07: a name of 40 bytes or more extends into the following columns, whose digits overwrite it
    void print(BufStr<255>& line, int unitsPerSecond) const;

    /// The same for a timer that may be null; then they do nothing.
    static void start(PileTimer* timer, bool beginSuspended);
    static void stop(PileTimer* timer);
    static void suspend(PileTimer* timer);
    static void resume(PileTimer* timer);
    static void reset(PileTimer* timer);

protected:
    /// Called around each addition to the statistics. In this class they do nothing.
    virtual void lock();
    virtual void unlock();

    /// The statistics in ticks, and how many measurements they contain.
    detail::Statistic<std::int64_t> total_;
    detail::Statistic<std::int64_t> suspendTotal_;
    detail::Statistic<std::int64_t> max_;
    detail::Statistic<std::int64_t> min_; ///< 0: none yet
    detail::Statistic<std::int64_t> suspendMax_;
    detail::Statistic<std::uint64_t> count_;
    /// The slot in the manager.
    std::uint64_t id_ = 0;
    detail::Statistic<std::uint64_t> maxCount_; ///< the count when max_ was set
    detail::Statistic<std::uint64_t> minCount_; ///< the count when min_ was set
    /// Whether misuse is reported, and the name.
    bool checks_;
    HeapStr name_;
};
ZB_INLINE_PARTS_END

} // namespace ZOR_Basis

#endif

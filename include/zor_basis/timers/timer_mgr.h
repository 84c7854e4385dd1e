/// \file
/// `TimerMgr`: a named group of pile timers, which it owns, finds by id, switches on and off as a whole, and reports.
///
/// `New` makes managers and lists them in one registry. They live as long as the process, and so do their timers. A
/// manager is inactive at first: nothing is measured through it until `setActive(true)`.
///
///     TimerMgr* const manager = TimerMgr::New("render", 0);
///     PileTimer* const pile = manager->createTimer("page", 0, true);
///     manager->setActive(true);
///     { BaseTimerAuto timer(pile, manager, true, false); render(); }
///     manager->reset(true); // writes a report
///
/// A report is a file in the folder "timer" of the root folder, named SECONDS_MANAGER_RIP.timer: the time in seconds
/// since 1970 UTC as a signed 32-bit number, the manager's name, and the number that `setRip` set. It consists of a
/// header of two lines, the line of column titles, and a row (`PileTimer::print`, in microseconds) for every timer in
/// ascending order of ids. An example of a name is "1700000000_render_0.timer".
///
/// \kept timers-08: reports of one manager within one second go into the same file, each with its own header
/// \thread thread-safe: `Mgr`, `New`, `Get`, `setRip`, `setActive`, `active`; with each other `createTimer`, `create`,
///     `reset` and `resetTimers`. Lookups by id (`get`, `getTimer`, `start(id)` and its siblings) take no lock. They
///     are safe while another thread creates a timer in an existing slot (`New` reserves slots), but not while a thread
///     creates one at a higher id or at the end, which may move all slots. One thread at a time drives a timer, as
///     `PileTimer` says

#ifndef ZOR_BASIS_TIMERS_TIMER_MGR_H
#define ZOR_BASIS_TIMERS_TIMER_MGR_H

#include "zor_basis/export.h"
#include "zor_basis/text/char_ops.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class PileTimer;
class TimerMgrMgr;

ZB_INLINE_PARTS_BEGIN
class ZB_API TimerMgr {
public:
    TimerMgr(TimerMgr const&) = delete;
    TimerMgr& operator=(TimerMgr const&) = delete;

    /// Makes a timer with its checks on; the manager owns it.
    /// \param name  is copied; null counts as the empty name
    /// \param id  selects the slot; 0: the slot after the last, which in an empty manager is slot 0
    /// \param forThreads  makes a `PileTimerMT`
    /// \kept timers-09: an earlier timer of the slot stays alive for its users, but the manager no longer knows it
    /// \pre id is not the highest 64-bit number
    /// \error if the slot was taken: assertion "TimerMgr::add() - already registered!" (line 356), then as above
    virtual PileTimer* createTimer(char const* name, std::uint64_t id, bool forThreads) = 0;
    /// Returns the timer of a slot; null if there is none.
    virtual PileTimer* getTimer(std::uint64_t id) = 0;
    /// Resets all timers, as `PileTimer::reset` does.
    /// \param print  writes a report first
    /// \kept timers-10: the timers are reset even if the report cannot be written
    /// \error if the report cannot be opened: assertion "TimerMgr::reset() - cannot open the report PATH". The function
    ///     first makes the folder "timer" if it is missing, but not the root
    virtual void resetTimers(bool print) = 0;

    /// Returns the registry of all managers. The first use of any manager makes it, together with the report folder.
    static TimerMgrMgr* Mgr();
    /// Makes a manager, which the registry keeps. Names need not be unique.
    /// \param maxId  reserves slots 0 to maxId unless it is 0: timers without an id of their own come after them
    /// \pre maxId is not the highest 64-bit number
    static TimerMgr* New(char const* name, std::uint64_t maxId);
    /// Returns the first manager of that name; null if there is none, and for null.
    static TimerMgr* Get(char const* name);
    /// Sets the number in the names of report files, initially 0.
    /// \kept timers-11: the first number other than 0 is final for the life of the process
    static void setRip(int rip);

    /// Calls `createTimer`; null for a null manager.
    static PileTimer* create(TimerMgr* manager, char const* name, std::uint64_t id, bool forThreads);
    /// Calls `getTimer`; null for a null manager.
    static PileTimer* get(TimerMgr* manager, std::uint64_t id);

    /// Switch the measurements through this manager on or off.
    void setActive(bool active) { active_.store(active, std::memory_order_relaxed); }
    bool active() const { return active_.load(std::memory_order_relaxed); }

    /// Call `PileTimer::start(false)`, `stop()`, `suspend()` and `resume()` of the timer in a slot. They do nothing
    /// while the manager is inactive, and if the slot is empty.
    void start(std::uint64_t id) {
        if (active()) startSlot(id);
    }
    void stop(std::uint64_t id) {
        if (active()) stopSlot(id);
    }
    void suspend(std::uint64_t id) {
        if (active()) suspendSlot(id);
    }
    void resume(std::uint64_t id) {
        if (active()) resumeSlot(id);
    }
    void start(int id) { start(static_cast<std::uint64_t>(id)); }
    void stop(int id) { stop(static_cast<std::uint64_t>(id)); }
    void suspend(int id) { suspend(static_cast<std::uint64_t>(id)); }
    void resume(int id) { resume(static_cast<std::uint64_t>(id)); }
    template <detail::Index I>
    void start(I id) {
        start(static_cast<std::uint64_t>(id));
    }
    template <detail::Index I>
    void stop(I id) {
        stop(static_cast<std::uint64_t>(id));
    }
    template <detail::Index I>
    void suspend(I id) {
        suspend(static_cast<std::uint64_t>(id));
    }
    template <detail::Index I>
    void resume(I id) {
        resume(static_cast<std::uint64_t>(id));
    }
    /// The same for a timer given directly; null does nothing.
    void start(PileTimer* timer);
    void stop(PileTimer* timer);
    void suspend(PileTimer* timer);
    void resume(PileTimer* timer);
    /// The same for a manager that may be null; then they do nothing.
    static void start(TimerMgr* manager, std::uint64_t id);
    static void start(TimerMgr* manager, int id) { start(manager, static_cast<std::uint64_t>(id)); }
    template <detail::Index I>
    static void start(TimerMgr* manager, I id) {
        start(manager, static_cast<std::uint64_t>(id));
    }
    static void start(TimerMgr* manager, PileTimer* timer);
    static void stop(TimerMgr* manager, std::uint64_t id);
    static void stop(TimerMgr* manager, int id) { stop(manager, static_cast<std::uint64_t>(id)); }
    template <detail::Index I>
    static void stop(TimerMgr* manager, I id) {
        stop(manager, static_cast<std::uint64_t>(id));
    }
    static void stop(TimerMgr* manager, PileTimer* timer);
    static void suspend(TimerMgr* manager, std::uint64_t id);
    static void suspend(TimerMgr* manager, int id) { suspend(manager, static_cast<std::uint64_t>(id)); }
    template <detail::Index I>
    static void suspend(TimerMgr* manager, I id) {
        suspend(manager, static_cast<std::uint64_t>(id));
    }
    static void suspend(TimerMgr* manager, PileTimer* timer);
    static void resume(TimerMgr* manager, std::uint64_t id);
    static void resume(TimerMgr* manager, int id) { resume(manager, static_cast<std::uint64_t>(id)); }
    template <detail::Index I>
    static void resume(TimerMgr* manager, I id) {
        resume(manager, static_cast<std::uint64_t>(id));
    }
    static void resume(TimerMgr* manager, PileTimer* timer);

    /// Calls `resetTimers` unless the manager is inactive.
    void reset(bool print);
    static void reset(TimerMgr* manager, bool print);

protected:
    TimerMgr() = default;
    virtual ~TimerMgr();

private:
    /// Checks again whether the manager is active, because that may change during the lookup.
    PileTimer* activeSlot(std::uint64_t id) {
        PileTimer* const timer = getTimer(id);
        return active() ? timer : nullptr;
    }
    void startSlot(std::uint64_t id);
    void stopSlot(std::uint64_t id);
    void suspendSlot(std::uint64_t id);
    void resumeSlot(std::uint64_t id);

    std::atomic<bool> active_{false};
};
ZB_INLINE_PARTS_END

} // namespace ZOR_Basis

#endif

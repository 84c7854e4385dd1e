/// \file
/// The timers of a manager by id.

#ifndef BASIS_TIMERS_TIMER_SLOTS_H
#define BASIS_TIMERS_TIMER_SLOTS_H

#include "zor_basis/containers/ptr_array.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class PileTimer;

/// Some slots are null. A slot that exists may be filled while other threads look timers up; growing the array is not
/// safe then.
class TimerSlots final : public PtrArray<PileTimer> {
public:
    using PtrArray::PtrArray;

    /// Everything written to the timer before is visible to a thread that reads the slot.
    void put(PileTimer* timer, std::uint64_t id) {
        if (id < count_) {
            std::atomic_ref(slots_[id]).store(timer, std::memory_order_release);
        } else {
            set(timer, id);
        }
    }

    /// \return also null at an index of the size or more
    PileTimer* find(std::uint64_t id) const {
        return id < count_ ? std::atomic_ref(slots_[id]).load(std::memory_order_acquire) : nullptr;
    }
};

} // namespace ZOR_Basis

#endif

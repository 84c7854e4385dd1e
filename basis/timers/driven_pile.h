/// \file
/// Which pile a scope timer drives.

#ifndef BASIS_TIMERS_DRIVEN_PILE_H
#define BASIS_TIMERS_DRIVEN_PILE_H

#include "zor_basis/timers/pile_timer.h"
#include "zor_basis/timers/timer_mgr.h"

namespace ZOR_Basis {

/// None while its manager is inactive.
inline PileTimer* drivenPile(PileTimer* pile, TimerMgr const* manager) {
    // kept timers-12: the answer of this moment is all that a scope timer keeps.
    return manager == nullptr || manager->active() ? pile : nullptr;
}

} // namespace ZOR_Basis

#endif

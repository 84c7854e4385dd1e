/// \file
/// Which pile a scope timer drives.

#ifndef BASIS_TIMERS_DRIVEN_PILE_H
#define BASIS_TIMERS_DRIVEN_PILE_H

#include "zor_basis/timers/pile_timer.h"
#include "zor_basis/timers/timer_mgr.h"

namespace ZOR_Basis {

/// Null while its manager is inactive.
inline PileTimer* drivenPile(PileTimer* pile, TimerMgr const* manager) {
    // kept timers-12: a scope timer keeps what it is told at this moment, and nothing else.
    return manager == nullptr || manager->active() ? pile : nullptr;
}

} // namespace ZOR_Basis

#endif

/// \file
/// Timers: measurements, piles of them, and managers that report them.

#ifndef ZOR_BASIS_TIMERS_H
#define ZOR_BASIS_TIMERS_H

#include "zor_basis/timers/base_timer.h"
#include "zor_basis/timers/base_timer_auto.h"
#include "zor_basis/timers/pile_timer.h"
#include "zor_basis/timers/pile_timer_auto.h"
#include "zor_basis/timers/pile_timer_mt.h"
#include "zor_basis/timers/thousands_separator.h"
#include "zor_basis/timers/timer_dat.h"
#include "zor_basis/timers/timer_mgr.h"

#endif

#include "zor_basis/timers/pile_timer_mt.h"

#include "basis/platform/xos_basics.h"

namespace ZOR_Basis {

PileTimerMT::PileTimerMT(char const* name, bool checks) : PileTimer(name, checks), semaphore_(xos_SemMCreate()) {}
PileTimerMT::~PileTimerMT() { xos_SemDestroy(semaphore_); }

void PileTimerMT::lock() { xos_SemTake(semaphore_); }
void PileTimerMT::unlock() { xos_SemGive(semaphore_); }

} // namespace ZOR_Basis

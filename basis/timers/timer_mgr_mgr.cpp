#include "basis/timers/timer_mgr_mgr.h"

#include "basis/ground/choices.h"
#include "basis/system/beneath_root.h"
#include "zor_basis/files/dir.h"

namespace ZOR_Basis {

TimerMgrMgr::TimerMgrMgr() : lock_(xos_SemMCreate()) {
    HeldSemaphore const held(lock_);
    dir_ = beneathRoot("timer");
    Dir::New(dir_.c_str(), WITHOUT_PARENTS);
}

void TimerMgrMgr::add(TimerMgrImpl* manager) {
    HeldSemaphore const held(lock_);
    managers_.insertBack(manager);
}

void TimerMgrMgr::setRip(std::int32_t rip) {
    if (rip == 0) return;
    HeldSemaphore const held(lock_);
    // kept timers-11: the number is the process's own and does not change under a report.
    if (rip_ == 0) rip_ = rip;
}

} // namespace ZOR_Basis

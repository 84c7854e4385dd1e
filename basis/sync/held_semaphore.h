/// \file
/// A semaphore of the platform layer, held for a scope.

#ifndef BASIS_SYNC_HELD_SEMAPHORE_H
#define BASIS_SYNC_HELD_SEMAPHORE_H

#include "basis/platform/xos_basics.h"

namespace ZOR_Basis {

/// If the semaphore cannot be taken, the scope runs all the same, and the semaphore is not given back.
class HeldSemaphore {
public:
    explicit HeldSemaphore(xos_Sem semaphore) : semaphore_(semaphore), taken_(xos_SemTake(semaphore) == 0) {}
    HeldSemaphore(HeldSemaphore const&) = delete;
    HeldSemaphore& operator=(HeldSemaphore const&) = delete;
    ~HeldSemaphore() {
        if (taken_) xos_SemGive(semaphore_);
    }

private:
    xos_Sem const semaphore_;
    bool const taken_;
};

} // namespace ZOR_Basis

#endif

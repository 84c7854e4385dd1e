#include "zor_basis/sync/lock.h"

#include "basis/platform/xos_basics.h"

namespace ZOR_Basis {

Lock::Lock(Type type, bool locked) : handle_(type == Binary ? xos_SemBCreate(locked ? 0 : 1) : xos_SemMCreate()) {
    if (type != Binary && locked) xos_SemTake(handle_);
}

// kept sync-01: the handle goes over as it is.
Lock& Lock::operator=(Lock const& other) = default;

Lock::~Lock() { xos_SemDestroy(handle_); }

void Lock::lock() { xos_SemTake(handle_); }
void Lock::unlock() { xos_SemGive(handle_); }

} // namespace ZOR_Basis

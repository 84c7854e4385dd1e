#include "zor_basis/sync/multi_task_queue.h"

#include "basis/sync/multi_task_queue_impl.h"

#include <new>

namespace ZOR_Basis {

MultiTaskQueue::~MultiTaskQueue() = default;

MultiTaskQueue* MultiTaskQueue::New(ErrPolicy policy, int limit) { return new (std::nothrow) MTQ_Impl(policy, limit); }

} // namespace ZOR_Basis

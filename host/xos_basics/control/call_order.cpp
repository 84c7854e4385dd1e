#include "host/xos_basics/control/call_order.h"

#include "host/xos_basics/control/order_stamp.h"

namespace host {

constinit std::atomic<std::uint64_t> commonTime{0};
constinit std::array<std::atomic<ThreadCalls*>, FUNCTION_COUNT> soleCaller{};

std::uint64_t stampOfSharedCall(Function function, ThreadCalls& caller) {
    std::atomic<ThreadCalls*>& sole = soleCaller[indexOf(function)];
    ThreadCalls* seen = sole.load(std::memory_order_relaxed);
    if (seen == nullptr && sole.compare_exchange_strong(seen, &caller, std::memory_order_relaxed)) return 0;
    if (seen != &spareThreadCalls) {
        // From here on every call is stamped, the former sole caller's too: a call of its that comes after this one
        // sees the mark.
        sole.store(&spareThreadCalls, std::memory_order_relaxed);
    }
    publishTime(caller);
    return orderStamp();
}

} // namespace host

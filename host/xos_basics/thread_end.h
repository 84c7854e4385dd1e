/// \file
/// A call at the end of each thread that asked for it. Twins: thread_end_posix.cpp, thread_end_win.cpp.

#ifndef HOST_XOS_BASICS_THREAD_END_H
#define HOST_XOS_BASICS_THREAD_END_H

#include <cstdint>

namespace host {

class ThreadEnd {
public:
    using Call = void (*)(void*);

    explicit ThreadEnd(Call call);

    /// Has `call` called with `value` when the calling thread ends; its earlier value is forgotten. A thread that sets
    /// a value while it ends is called once more.
    void set(void* value) const;

private:
    std::uint32_t key_{0};
};

} // namespace host

#endif

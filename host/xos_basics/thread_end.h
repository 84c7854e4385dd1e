/// \file
/// Calls a function at the end of each thread that asked for it. Twins: thread_end_posix.cpp, thread_end_win.cpp.

#ifndef HOST_XOS_BASICS_THREAD_END_H
#define HOST_XOS_BASICS_THREAD_END_H

#include <cstdint>

namespace host {

class ThreadEnd {
public:
    using Call = void (*)(void*);

    explicit ThreadEnd(Call call);

    /// Makes the end of the calling thread call the function with `value`, which replaces an earlier value. If the
    /// function sets a value again, it is called again.
    void set(void* value) const;

private:
    std::uint32_t key_{0};
};

} // namespace host

#endif

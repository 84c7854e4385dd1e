/// \file
/// Children that run independently. Linux keeps the exit status of a child until it is awaited; Windows does not, so
/// callers need not await one.

#ifndef BASIS_SYSTEM_UNAWAITED_POSIX_H
#define BASIS_SYSTEM_UNAWAITED_POSIX_H

#include <algorithm>
#include <array>
#include <cstddef>
#include <mutex>

#include <sys/types.h>

namespace ZOR_Basis {

/// Keeps their number bounded: when there is no more room, those of the older half that have ended are given up.
/// \tparam GIVE_UP  `bool (*)(pid_t)`: takes what is left of a child, if it has ended; false while it still runs
/// \thread thread-safe
template <std::size_t MOST, auto GIVE_UP>
class Unawaited {
public:
    /// If all older children still run and there is no room for this one, it is never collected.
    void add(pid_t child) {
        std::lock_guard const lock(mutex_);
        if (size_ == MOST) giveUpOlderHalf();
        if (size_ < MOST) children_[size_++] = child;
    }

    /// Leaves it to the caller to await the child.
    /// \return false if it is not among these
    bool remove(pid_t child) {
        std::lock_guard const lock(mutex_);
        auto* const end = children_.data() + size_;
        auto* const found = std::find(children_.data(), end, child);
        if (found == end) return false;
        std::copy(found + 1, end, found);
        --size_;
        return true;
    }

private:
    void giveUpOlderHalf() {
        auto* const begin = children_.data();
        auto* const half = begin + MOST / 2;
        auto* const kept = std::remove_if(begin, half, GIVE_UP);
        size_ = static_cast<std::size_t>(std::copy(half, begin + size_, kept) - begin);
    }

    std::mutex mutex_;
    std::array<pid_t, MOST> children_{};
    std::size_t size_ = 0;
};

} // namespace ZOR_Basis

#endif

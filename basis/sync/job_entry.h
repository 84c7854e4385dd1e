/// \file
/// `JobEntry`: a job in the list of its queue; `JobCursor`: a place in that list.

#ifndef BASIS_SYNC_JOB_ENTRY_H
#define BASIS_SYNC_JOB_ENTRY_H

#include "zor_basis/sync/mtq_dat.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class JobEntry;

struct JobLinks {
    JobEntry* previous = nullptr;
    JobEntry* next = nullptr;
};

class JobEntry final : public JobLinks, public MTQ_Dat {
public:
    JobEntry(MultiTaskQueue* queue, Task run, Function function, void* argument, bool ownsArgument, bool removeWhenDone)
        : MTQ_Dat(queue, run, function, argument, ownsArgument, removeWhenDone) {}

    using MTQ_Dat::callFunction;
    using MTQ_Dat::finish;
    using MTQ_Dat::queue;
    using MTQ_Dat::removesWhenDone;
    using MTQ_Dat::Task;
};

/// A position at an entry, just before an entry, or nowhere. It is one word, so it can be read while others change it.
class JobCursor {
public:
    void moveTo(JobEntry* entry) { place_.store(wordOf(entry), std::memory_order_release); }
    /// Moves to the next entry.
    /// \pre the cursor is not nowhere
    void advance() {
        JobEntry* const entry = nearest();
        moveTo(isBetween() ? entry : entry->next);
    }
    /// Must be called before an entry is unlinked.
    void leave(JobEntry const* entry) {
        if (nearest() == entry) place_.store(wordOf(entry->next) | BETWEEN, std::memory_order_release);
    }

    bool isNowhere() const { return nearest() == nullptr; }
    /// \return null also between entries
    JobEntry* entry() const {
        std::uintptr_t const place = place_.load(std::memory_order_acquire);
        return (place & BETWEEN) == 0 ? reinterpret_cast<JobEntry*>(place) : nullptr;
    }

private:
    static constexpr std::uintptr_t BETWEEN = 1;

    static std::uintptr_t wordOf(JobEntry* entry) { return reinterpret_cast<std::uintptr_t>(entry); }
    bool isBetween() const { return (place_.load(std::memory_order_acquire) & BETWEEN) != 0; }
    JobEntry* nearest() const { return reinterpret_cast<JobEntry*>(place_.load(std::memory_order_acquire) & ~BETWEEN); }

    std::atomic<std::uintptr_t> place_{0};
};

} // namespace ZOR_Basis

#endif

/// \file
/// `SemSynList`: one bucket of a set of locks, the list of the keys in it that are held or awaited.

#ifndef BASIS_SYNC_SEM_SYN_LIST_H
#define BASIS_SYNC_SEM_SYN_LIST_H

#include "basis/platform/xos_basics.h"
#include "basis/sync/sequence_lock.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class MemMgr;

/// Buckets stand side by side in a table, each on cache lines of its own.
class alignas(64) SemSynList {
public:
    SemSynList();
    SemSynList(SemSynList const&) = delete;
    SemSynList& operator=(SemSynList const&) = delete;
    // Not virtual: a bucket is never deleted through another type.
    ~SemSynList();

    virtual bool take(std::uint64_t key);
    virtual bool give(std::uint64_t key);

    std::uint64_t size() const { return count_; }
    /// Whether links, ends and count agree and every entry has users.
    /// \pre nothing else runs
    bool isConsistent() const;

private:
    /// The atomic members are read without the list mutex.
    struct Entry {
        std::atomic<Entry*> previous;
        std::atomic<Entry*> next;
        xos_Sem mutex;
        std::atomic<std::uint64_t> key;
        std::uint64_t users;
    };

    static Entry* load(std::atomic<Entry*> const& link) { return link.load(std::memory_order_acquire); }
    static void store(std::atomic<Entry*>& link, Entry* entry) { link.store(entry, std::memory_order_release); }

    Entry* find(std::uint64_t key) const;
    Entry* search(std::uint64_t key) const;
    Entry* enter(std::uint64_t key);
    Entry* makeEntry();
    void linkFront(Entry* entry);
    void unlink(Entry* entry);

    xos_Sem listMutex_;
    std::atomic<Entry*> first_{nullptr};
    std::atomic<Entry*> last_{nullptr};
    std::uint64_t count_ = 0;
    MemMgr* entryMemory_ = nullptr;
    /// Entries without users, kept for the next key because a concurrent search may still read them.
    Entry* spare_ = nullptr;
    /// Detects that links have changed during a search.
    mutable SequenceLock links_;
};

} // namespace ZOR_Basis

#endif

/// \file
/// `SemSynList`: one bucket of a set of locks, the list of the keys in it that are held or awaited.

#ifndef BASIS_SYNC_SEM_SYN_LIST_H
#define BASIS_SYNC_SEM_SYN_LIST_H

#include "basis/platform/xos_basics.h"
#include "basis/sync/spin_lock.h"

#include <cstdint>

namespace ZOR_Basis {

class MemMgr;

class SemSynList {
public:
    SemSynList();
    SemSynList(SemSynList const&) = delete;
    SemSynList& operator=(SemSynList const&) = delete;
    // Not virtual: nobody deletes a bucket by another type.
    ~SemSynList();

    virtual bool take(std::uint64_t key);
    virtual bool give(std::uint64_t key);

    std::uint64_t size() const { return count_; }
    /// Whether links, ends and count agree and every entry has users. \pre nothing else runs
    bool isConsistent() const;

private:
    struct Entry {
        Entry* previous;
        Entry* next;
        xos_Sem mutex;
        std::uint64_t key;
        std::uint64_t users;
    };

    /// \pre the link lock is held
    Entry* find(std::uint64_t key) const;
    Entry* enter(std::uint64_t key);
    Entry* makeEntry(std::uint64_t key);
    void freeEntry(Entry* entry);
    void linkFront(Entry* entry);
    void unlink(Entry* entry);

    xos_Sem listMutex_;
    Entry* first_ = nullptr;
    Entry* last_ = nullptr;
    std::uint64_t count_ = 0;
    MemMgr* entryMemory_ = nullptr;
    /// Guards the links and the users where the list mutex is not held.
    mutable SpinLock links_;
};

} // namespace ZOR_Basis

#endif

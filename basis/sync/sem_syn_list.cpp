#include "basis/sync/sem_syn_list.h"

#include "zor_basis/memory/mem_mgr.h"

#include <mutex>
#include <new>

namespace ZOR_Basis {

SemSynList::SemSynList() : listMutex_(xos_SemMCreate()) {}

SemSynList::~SemSynList() {
    xos_SemDestroy(listMutex_);
    while (first_ != nullptr) {
        Entry* const entry = first_;
        unlink(entry);
        xos_SemDestroy(entry->mutex);
        freeEntry(entry);
    }
}

bool SemSynList::take(std::uint64_t key) {
    if (xos_SemTake(listMutex_) != 0) return false;
    Entry* const entry = enter(key);
    xos_SemGive(listMutex_);
    // Waiting for one key must hold up no other: the list is free meanwhile, and the entry stays as it has a user.
    return entry != nullptr && xos_SemTake(entry->mutex) == 0;
}

bool SemSynList::give(std::uint64_t key) {
    // The caller holds the key, so its entry can be found before the list is taken, and cannot go meanwhile.
    links_.lock();
    Entry* const entry = find(key);
    links_.unlock();
    xos_SemTake(listMutex_);
    bool given = false;
    if (entry != nullptr) {
        links_.lock();
        bool const unused = --entry->users == 0;
        if (unused) unlink(entry);
        links_.unlock();
        given = xos_SemGive(entry->mutex) == 0;
        if (unused) {
            xos_SemDestroy(entry->mutex);
            freeEntry(entry);
        }
    }
    xos_SemGive(listMutex_);
    return given;
}

SemSynList::Entry* SemSynList::find(std::uint64_t key) const {
    Entry* entry = first_;
    while (entry != nullptr && entry->key != key) entry = entry->next;
    return entry;
}

/// One more user for a key's entry, which is made if there is none. \pre the list mutex is held
SemSynList::Entry* SemSynList::enter(std::uint64_t key) {
    {
        std::lock_guard const lock(links_);
        if (Entry* const entry = find(key)) {
            ++entry->users;
            return entry;
        }
    }
    // Entries are made under the list mutex only, so nobody makes one for this key at the same time.
    Entry* const entry = makeEntry(key);
    if (entry == nullptr) return nullptr;
    std::lock_guard const lock(links_);
    linkFront(entry);
    return entry;
}

SemSynList::Entry* SemSynList::makeEntry(std::uint64_t key) {
    void* const memory = entryMemory_ != nullptr ? entryMemory_->alloc() : ::operator new(sizeof(Entry), std::nothrow);
    return memory != nullptr ? new (memory) Entry{nullptr, nullptr, xos_SemMCreate(), key, 1} : nullptr;
}

void SemSynList::freeEntry(Entry* entry) {
    if (entryMemory_ != nullptr) {
        entryMemory_->free(entry);
    } else {
        ::operator delete(entry, sizeof(Entry));
    }
}

void SemSynList::linkFront(Entry* entry) {
    entry->next = first_;
    (first_ != nullptr ? first_->previous : last_) = entry;
    first_ = entry;
    ++count_;
}

void SemSynList::unlink(Entry* entry) {
    (entry->previous != nullptr ? entry->previous->next : first_) = entry->next;
    (entry->next != nullptr ? entry->next->previous : last_) = entry->previous;
    --count_;
}

bool SemSynList::isConsistent() const {
    std::uint64_t entries = 0;
    Entry const* previous = nullptr;
    for (Entry const* entry = first_; entry != nullptr && entries <= count_; entry = entry->next, ++entries) {
        if (entry->previous != previous || entry->users == 0) return false;
        previous = entry;
    }
    return entries == count_ && previous == last_;
}

} // namespace ZOR_Basis

#include "basis/sync/sem_syn_list.h"

#include "basis/memory/node_memory.h"

namespace ZOR_Basis {

SemSynList::SemSynList() : listMutex_(xos_SemMCreate()) {}

SemSynList::~SemSynList() {
    xos_SemDestroy(listMutex_);
    while (Entry* const entry = load(first_)) {
        unlink(entry);
        xos_SemDestroy(entry->mutex);
        deleteNode(entryMemory_, entry);
    }
    while (Entry* const entry = spare_) {
        spare_ = load(entry->next);
        deleteNode(entryMemory_, entry);
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
    Entry* const entry = search(key);
    xos_SemTake(listMutex_);
    bool given = false;
    if (entry != nullptr) {
        links_.beginWriting();
        bool const unused = --entry->users == 0;
        if (unused) unlink(entry);
        links_.endWriting();
        given = xos_SemGive(entry->mutex) == 0;
        if (unused) {
            xos_SemDestroy(entry->mutex);
            store(entry->next, spare_);
            spare_ = entry;
        }
    }
    xos_SemGive(listMutex_);
    return given;
}

/// \pre the list mutex is held
SemSynList::Entry* SemSynList::find(std::uint64_t key) const {
    Entry* entry = load(first_);
    while (entry != nullptr && entry->key.load(std::memory_order_acquire) != key) entry = load(entry->next);
    return entry;
}

/// The same without the list mutex, again and again until nothing has changed meanwhile.
SemSynList::Entry* SemSynList::search(std::uint64_t key) const {
    for (;;) {
        std::uint32_t const before = links_.beginReading();
        Entry* entry = load(first_);
        while (entry != nullptr && entry->key.load(std::memory_order_acquire) != key && links_.isUnchanged(before)) {
            entry = load(entry->next);
        }
        if (links_.isUnchanged(before)) return entry;
    }
}

/// One more user for a key's entry, which is made if there is none. \pre the list mutex is held
SemSynList::Entry* SemSynList::enter(std::uint64_t key) {
    Entry* entry = find(key);
    bool const isNew = entry == nullptr;
    if (isNew) entry = makeEntry();
    if (entry == nullptr) return nullptr;
    links_.beginWriting();
    if (isNew) {
        entry->key.store(key, std::memory_order_release);
        linkFront(entry);
    }
    ++entry->users;
    links_.endWriting();
    return entry;
}

SemSynList::Entry* SemSynList::makeEntry() {
    Entry* entry = spare_;
    if (entry != nullptr) {
        spare_ = load(entry->next);
    } else {
        entry = makeNode<Entry>(entryMemory_);
        if (entry == nullptr) return nullptr;
    }
    entry->mutex = xos_SemMCreate();
    return entry;
}

void SemSynList::linkFront(Entry* entry) {
    Entry* const second = load(first_);
    store(entry->previous, nullptr);
    store(entry->next, second);
    store(second != nullptr ? second->previous : last_, entry);
    store(first_, entry);
    ++count_;
}

void SemSynList::unlink(Entry* entry) {
    Entry* const previous = load(entry->previous);
    Entry* const next = load(entry->next);
    store(previous != nullptr ? previous->next : first_, next);
    store(next != nullptr ? next->previous : last_, previous);
    --count_;
}

bool SemSynList::isConsistent() const {
    std::uint64_t entries = 0;
    Entry const* previous = nullptr;
    for (Entry const* entry = load(first_); entry != nullptr && entries <= count_; entry = load(entry->next)) {
        if (load(entry->previous) != previous || entry->users == 0) return false;
        previous = entry;
        ++entries;
    }
    return entries == count_ && previous == load(last_);
}

} // namespace ZOR_Basis

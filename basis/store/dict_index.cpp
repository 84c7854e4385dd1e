#include "basis/store/dict_index.h"

#include "zor_basis/ground/loads.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t FIRST_SLOTS = 256;
constexpr std::uint64_t GROWTH = 4;
/// Odd, and half of its bits set, so that a product mixes all that is below into its upper bits.
constexpr std::uint64_t MIXER = 0x9E3779B97F4A7C15;

std::uint64_t mix(std::uint64_t hash, std::uint64_t word) {
    hash = (hash ^ word) * MIXER;
    return hash ^ hash >> 32;
}

std::uint32_t hashOf(RecordBytes key) {
    std::uint64_t hash = key.size;
    std::uint64_t at = 0;
    for (; key.size - at >= sizeof(std::uint64_t); at += sizeof(std::uint64_t)) {
        hash = mix(hash, detail::loadWord<std::uint64_t>(key.place + at));
    }
    std::uint64_t word = 0;
    std::memcpy(&word, key.place + at, key.size - at);
    return static_cast<std::uint32_t>(mix(mix(hash, word), 0));
}

bool isKey(Blob const& blob, RecordBytes key) {
    return blob.size() == key.size && (key.size == 0 || std::memcmp(blob.val(), key.place, key.size) == 0);
}

} // namespace

DictIndex::Entry* DictIndex::find(RecordBytes key) {
    if (slots_.empty()) grow();
    hash_ = hashOf(key);
    for (std::uint64_t at = hash_ & mask_; slots_[at].number != 0; at = (at + 1) & mask_) {
        if (slots_[at].hash != hash_) continue;
        Entry* const entry = entries_[slots_[at].number - 1];
        if (isKey(entry->key, key)) return entry;
    }
    return nullptr;
}

void DictIndex::add(Entry* entry) {
    entries_.push_back(entry);
    freeSlot(hash_) = {hash_, static_cast<std::uint32_t>(entries_.size())};
    if (2 * entries_.size() > slots_.size()) grow();
}

DictIndex::Slot& DictIndex::freeSlot(std::uint32_t hash) {
    std::uint64_t at = hash & mask_;
    while (slots_[at].number != 0) at = (at + 1) & mask_;
    return slots_[at];
}

void DictIndex::grow() {
    std::vector<Slot> old(slots_.empty() ? FIRST_SLOTS : GROWTH * slots_.size());
    old.swap(slots_);
    mask_ = slots_.size() - 1;
    for (Slot const& slot : old) {
        if (slot.number != 0) freeSlot(slot.hash) = slot;
    }
}

} // namespace ZOR_Basis

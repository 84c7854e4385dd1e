#include "basis/containers/dict_index.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t FIRST_SLOTS = 64;
/// Odd, and half of its bits set, so that a product mixes all that is below into its upper bits.
constexpr std::uint64_t MIXER = 0x9E3779B97F4A7C15;

std::uint64_t mix(std::uint64_t hash, std::uint64_t word) {
    hash = (hash ^ word) * MIXER;
    return hash ^ hash >> 32;
}

std::uint64_t hashOf(RecordBytes key) {
    std::uint64_t hash = key.size;
    std::uint64_t at = 0;
    std::uint64_t word = 0;
    for (; key.size - at >= sizeof word; at += sizeof word) {
        std::memcpy(&word, key.place + at, sizeof word);
        hash = mix(hash, word);
    }
    word = 0;
    std::memcpy(&word, key.place + at, key.size - at);
    return mix(mix(hash, word), 0);
}

bool isKey(Blob const& blob, RecordBytes key) {
    return blob.size() == key.size && (key.size == 0 || std::memcmp(blob.val(), key.place, key.size) == 0);
}

} // namespace

DictIndex::Entry* DictIndex::find(RecordBytes key) {
    if (2 * used_ >= mask_) grow();
    std::uint64_t const hash = hashOf(key);
    std::uint64_t at = hash & mask_;
    for (; slots_[at].entry != nullptr; at = (at + 1) & mask_) {
        if (slots_[at].hash == hash && isKey(slots_[at].entry->key, key)) return slots_[at].entry;
    }
    slots_[at].hash = hash;
    free_ = at;
    ++used_;
    return nullptr;
}

std::uint64_t DictIndex::freeSlot(std::uint64_t hash) const {
    std::uint64_t at = hash & mask_;
    while (slots_[at].entry != nullptr) at = (at + 1) & mask_;
    return at;
}

void DictIndex::grow() {
    std::unique_ptr<Slot[]> const old = std::move(slots_);
    std::uint64_t const oldCount = old != nullptr ? mask_ + 1 : 0;
    std::uint64_t const count = old != nullptr ? 2 * oldCount : FIRST_SLOTS;
    slots_ = std::make_unique<Slot[]>(count);
    mask_ = count - 1;
    for (std::uint64_t i = 0; i < oldCount; ++i) {
        if (old[i].entry != nullptr) slots_[freeSlot(old[i].hash)] = old[i];
    }
}

} // namespace ZOR_Basis

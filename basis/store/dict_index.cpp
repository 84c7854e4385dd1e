#include "basis/store/dict_index.h"

#include "zor_basis/ground/loads.h"

#include <algorithm>
#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t FIRST_SLOTS = 128;
constexpr std::uint64_t GROWTH = 4;
/// Odd, and half of its bits set, so that a product mixes all that is below into its upper bits.
constexpr std::uint64_t MIXER = 0x9E3779B97F4A7C15;

std::uint64_t mix(std::uint64_t hash, std::uint64_t word) {
    hash = (hash ^ word) * MIXER;
    return hash ^ hash >> 32;
}

std::uint32_t hashOf(std::uint64_t size, char const* key) {
    using detail::loadWord;
    constexpr std::uint64_t WORD = sizeof(std::uint64_t);
    std::uint64_t hash = size;
    std::uint64_t last = 0;
    if (size >= WORD) {
        for (std::uint64_t at = 0; at + WORD < size; at += WORD) hash = mix(hash, loadWord<std::uint64_t>(key + at));
        last = loadWord<std::uint64_t>(key + size - WORD);
    } else if (size != 0) {
        std::memcpy(&last, key, size);
    }
    return static_cast<std::uint32_t>(mix(mix(hash, last), 0));
}

bool isKey(Blob const& blob, std::uint64_t size, char const* key) {
    return blob.size() == size && (size == 0 || std::memcmp(blob.val(), key, size) == 0);
}

} // namespace

DictIndex::Entry* DictIndex::find(std::uint64_t size, char const* key) const {
    if (count_ == 0) return nullptr;
    std::uint32_t const hash = hashOf(size, key);
    for (std::uint64_t at = hash & mask_; slots_[at].entry != nullptr; at = next(at)) {
        if (slots_[at].hash == hash && isKey(slots_[at].entry->key, size, key)) return slots_[at].entry;
    }
    return nullptr;
}

bool DictIndex::add(Entry* entry) {
    if (count_ == limit_ && !grow()) return false;
    put({entry, hashOf(entry->key.size(), entry->key.val())});
    ++count_;
    return true;
}

void DictIndex::remove(Entry const* entry) {
    std::uint64_t hole = hashOf(entry->key.size(), entry->key.val()) & mask_;
    while (slots_[hole].entry != entry) hole = next(hole);
    for (std::uint64_t at = next(hole); slots_[at].entry != nullptr; at = next(at)) {
        // A search that begins behind the hole would not find the entry there.
        if (distance(slots_[at].hash & mask_, at) < distance(hole, at)) continue;
        slots_[hole] = slots_[at];
        hole = at;
    }
    slots_[hole] = {};
    --count_;
}

void DictIndex::put(Slot slot) {
    std::uint64_t at = slot.hash & mask_;
    while (slots_[at].entry != nullptr) at = next(at);
    slots_[at] = slot;
}

bool DictIndex::grow() {
    std::uint64_t const slots = std::max(FIRST_SLOTS, GROWTH * (mask_ + 1));
    decltype(slots_) old(static_cast<Slot*>(std::calloc(slots, sizeof(Slot))));
    if (old == nullptr) return false;
    old.swap(slots_);
    std::uint64_t const oldSlots = old != nullptr ? mask_ + 1 : 0;
    mask_ = slots - 1;
    limit_ = slots / 2;
    for (std::uint64_t at = 0; at < oldSlots; ++at) {
        if (old[at].entry != nullptr) put(old[at]);
    }
    return true;
}

} // namespace ZOR_Basis

#include "zor_basis/store/dict.h"

#include "basis/files/replacement.h"
#include "basis/files/system_calls.h"
#include "basis/ground/choices.h"
#include "basis/store/dict_index.h"
#include "basis/store/dict_records.h"
#include "zor_basis/files/file.h"

#include <cstring>
#include <new>
#include <utility>

namespace ZOR_Basis {
namespace {

constexpr int LOAD = File::FILE_READ | File::FILE_BINARY | File::FILE_SEQUENTIAL;
constexpr int SAVE = File::FILE_WRITE | File::FILE_TRUNC | File::FILE_BINARY | File::FILE_SEQUENTIAL;
constexpr int SAVE_BESIDE = SAVE | File::FILE_NOCREATEFLAG;

/// Small dictionaries are searched at least as fast as their index.
constexpr std::uint64_t FEWEST_INDEXED = 16;

bool isSame(Blob const& blob, std::uint64_t size, char const* bytes) {
    return blob.size() == size && (size == 0 || std::memcmp(blob.val(), bytes, size) == 0);
}

/// The size of a file according to the system; 0 if the system does not report one.
std::uint64_t sizeOf(char const* path) {
    xos_Stat status{};
    return systemCalls.statusOfTarget(path, status) ? static_cast<std::uint64_t>(status.st_size_) : 0;
}

/// Tells whether the records are the whole file. A failed read looks like the end of the file, so this checks the size.
bool isWhole(RecordReader const& records, char const* path) {
    return records.position() == records.arrived() && records.arrived() >= sizeOf(path);
}

} // namespace

template <class K, class V>
Dict<K, V>::Dict(Str const& path) : path_(path), modified_(true) {
    read();
}

template <class K, class V>
Dict<K, V>::~Dict() {
    dropIndex();
}

template <class K, class V>
typename Dict<K, V>::Entry* Dict<K, V>::find(std::uint64_t size, char const* key) const {
    if (index() == nullptr && this->size() >= FEWEST_INDEXED) makeIndex();
    if (index_ != nullptr) return index_->find(size, key);
    for (Unit* unit = this->head(); unit != nullptr; unit = unit->next) {
        if (isSame(unit->value.key, size, key)) return &unit->value;
    }
    return nullptr;
}

/// The index, if there is one. Ends one that callers may have made wrong.
template <class K, class V>
DictIndex* Dict<K, V>::index() const {
    // Nothing that callers hold leads to a later entry of a list that is empty now.
    if (this->head() == nullptr) this->unitCount().endExposure();
    if (this->head() == nullptr || this->unitCount().isExposed) dropIndex();
    return index_;
}

template <class K, class V>
void Dict<K, V>::makeIndex() const {
    if (this->unitCount().isExposed) return;
    index_ = new (std::nothrow) DictIndex;
    for (Unit* unit = this->head(); unit != nullptr && index_ != nullptr; unit = unit->next) {
        if (!index_->add(&unit->value)) dropIndex();
    }
}

template <class K, class V>
void Dict<K, V>::dropIndex() const {
    delete std::exchange(index_, nullptr);
}

template <class K, class V>
void Dict<K, V>::add(Unit* unit) {
    this->linkFront(unit);
    if (index() != nullptr && !index_->add(&unit->value)) dropIndex();
}

template <class K, class V>
void Dict<K, V>::drop(Unit* previous, Unit* unit) {
    if (index() != nullptr) index_->remove(&unit->value);
    delete this->unlink(previous, unit);
}

template <class K, class V>
bool Dict<K, V>::get(K const& key, V& out) const {
    Entry const* const entry = find(key);
    if (entry == nullptr) return false;
    out = entry->value;
    return true;
}

template <class K, class V>
void Dict<K, V>::set(K const& key, V const& value) {
    modified_ = true;
    Entry* const entry = find(key);
    if (entry == nullptr) {
        add(new Unit{nullptr, Entry(key, value)});
    } else if (entry->value == value) {
        // kept dict-01: callers that store the same value repeatedly do not write the file because of it.
        modified_ = false;
    } else {
        entry->set(value);
    }
}

template <class K, class V>
void Dict<K, V>::rm(K const& key) {
    Entry const* const entry = find(key);
    if (entry == nullptr) return;
    Unit* previous = nullptr;
    Unit* unit = this->head();
    while (&unit->value != entry) previous = std::exchange(unit, unit->next);
    drop(previous, unit);
    modified_ = true;
}

template <class K, class V>
void Dict<K, V>::clean() {
    if (this->head() == nullptr) return;
    modified_ = true;
    this->clear();
}

template <class K, class V>
void Dict<K, V>::intersect(Dict const& other) {
    // kept dict-02: the remaining entries are a temporary view; the file keeps the others.
    Unit* previous = nullptr;
    for (Unit* unit = this->head(); unit != nullptr;) {
        Unit* const next = unit->next;
        if (other.find(unit->value.key) == nullptr) {
            drop(previous, unit);
        } else {
            previous = unit;
        }
        unit = next;
    }
}

/// Stores every record, each by the steps of storing a key.
template <class K, class V>
void Dict<K, V>::load(RecordReader& records) {
    K const empty;
    while (records.next()) {
        RecordBytes const key = records.key();
        RecordBytes const value = records.value();
        Entry* entry = find(key.size, key.place);
        if (entry == nullptr) {
            // kept dict-03: a new key goes to the front.
            Unit* const unit = new Unit{nullptr, Entry(empty)};
            entry = &unit->value;
            entry->key.copy(key.size, key.place);
            add(unit);
        }
        if (!isSame(entry->value, value.size, value.place)) entry->value.copy(value.size, value.place);
    }
}

template <class K, class V>
bool Dict<K, V>::read() {
    clean();
    found_ = DICT_NOT_READ;
    understood_ = 0;
    File file;
    if (!file.open(path_, LOAD, WITHOUT_CREATE_FLAG)) {
        if (path_.some() && systemCalls.lastError() == FILE_NOT_FOUND) found_ = DICT_MISSING;
        return false;
    }
    RecordReader records(*file.ptr());
    load(records);
    found_ = isWhole(records, path_) ? DICT_WHOLE : DICT_PART;
    understood_ = records.position();
    modified_ = false;
    return true;
}

template <class K, class V>
bool Dict<K, V>::put(IFile& file) const {
    RecordWriter records(file);
    for (Unit* unit = this->head(); unit != nullptr; unit = unit->next) {
        if (!records.add(unit->value.key) || !records.add(unit->value.value)) return false;
    }
    return records.finish();
}

template <class K, class V>
bool Dict<K, V>::save() {
    Replacement replacement;
    if (!replacement.open(path_, SAVE_BESIDE)) return false;
    if (!put(replacement.content()) || !replacement.putInPlace()) return false;
    modified_ = false;
    return true;
}

template <class K, class V>
bool Dict<K, V>::write() {
    if (!modified_) return true;
    File file;
    if (!file.open(path_, SAVE, WITHOUT_CREATE_FLAG)) return false;
    if (!put(*file.ptr())) return false;
    modified_ = false;
    return true;
}

ZB_INSTANTIATE_TEMPLATE Dict<Blob, Blob>;

} // namespace ZOR_Basis

#include "zor_basis/store/dict.h"

#include "basis/files/replacement.h"
#include "basis/files/system_calls.h"
#include "basis/ground/choices.h"
#include "basis/store/dict_index.h"
#include "basis/store/dict_records.h"
#include "zor_basis/files/file.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr int LOAD = File::FILE_READ | File::FILE_BINARY | File::FILE_SEQUENTIAL;
constexpr int SAVE = File::FILE_WRITE | File::FILE_TRUNC | File::FILE_BINARY | File::FILE_SEQUENTIAL;
constexpr int SAVE_BESIDE = SAVE | File::FILE_NOCREATEFLAG;

bool isValue(Blob const& blob, RecordBytes bytes) {
    return blob.size() == bytes.size && (bytes.size == 0 || std::memcmp(blob.val(), bytes.place, bytes.size) == 0);
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

/// Puts the records into an empty list.
void load(RecordReader& records, SngList<DictEntry<Blob, Blob>>& list) {
    using Entry = DictEntry<Blob, Blob>;
    using Unit = SngList<Entry>::Unit;
    Blob const empty;
    DictIndex index;
    while (records.next()) {
        RecordBytes const key = records.key();
        RecordBytes const value = records.value();
        Entry* entry = index.find(key);
        if (entry == nullptr) {
            // kept dict-03: the steps of storing a key put each before the others.
            list.insertFront(new Unit{nullptr, Entry(empty)});
            entry = &list.first()->value;
            entry->key.copy(key.size, key.place);
            index.add(entry);
        }
        if (!isValue(entry->value, value)) entry->value.copy(value.size, value.place);
    }
}

} // namespace

template <class K, class V>
Dict<K, V>::Dict(Str const& path) : path_(path), modified_(true) {
    read();
}

template <class K, class V>
typename Dict<K, V>::Entry* Dict<K, V>::find(K const& key) const {
    for (auto* unit = this->first(); unit != nullptr; unit = unit->next) {
        if (unit->value.eq(key)) return &unit->value;
    }
    return nullptr;
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
        this->insertFront(new typename SngList<Entry>::Unit{nullptr, Entry(key, value)});
    } else if (entry->value == value) {
        // kept dict-01: callers that store the same value repeatedly do not write the file because of it.
        modified_ = false;
    } else {
        entry->set(value);
    }
}

template <class K, class V>
void Dict<K, V>::rm(K const& key) {
    for (auto at = this->begin(); at != this->end(); ++at) {
        if (!at->eq(key)) continue;
        this->remove(at);
        modified_ = true;
        return;
    }
}

template <class K, class V>
void Dict<K, V>::clean() {
    if (this->first() == nullptr) return;
    modified_ = true;
    this->clear();
}

template <class K, class V>
void Dict<K, V>::intersect(Dict const& other) {
    // kept dict-02: the remaining entries are a temporary view; the file keeps the others.
    for (auto at = this->begin(); at != this->end();) {
        if (other.find(at->key) == nullptr) {
            this->remove(at);
        } else {
            ++at;
        }
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
    load(records, *this);
    found_ = isWhole(records, path_) ? DICT_WHOLE : DICT_PART;
    understood_ = records.position();
    modified_ = false;
    return true;
}

template <class K, class V>
bool Dict<K, V>::put(IFile& file) const {
    RecordWriter records(file);
    for (auto* unit = this->first(); unit != nullptr; unit = unit->next) {
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

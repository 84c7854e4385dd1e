#include "tests/faults/scenario.h"

#include <zor_basis/files/file.h>
#include <zor_basis/store/blob.h>
#include <zor_basis/store/dict.h>

using namespace ZOR_Basis;

namespace {

using BlobDict = Dict<Blob, Blob>;

Blob blob(std::string const& text) { return {text.size(), text.c_str()}; }

void fill(BlobDict& dict, int entries, char const* value) {
    for (int i = 0; i < entries; ++i) dict.set(blob("key " + std::to_string(i)), blob(value));
}

/// A dictionary's file with ten entries.
void prepareDict(Place const& place) {
    BlobDict dict;
    dict.setPath(Str(place / "dict"));
    fill(dict, 10, "old");
    dict.write();
}

bool holds(BlobDict const& dict, int entries, char const* value) {
    Blob found;
    return dict.size() == static_cast<std::uint64_t>(entries) && dict.get(blob("key 0"), found) && found == blob(value);
}

/// An entry that there was no memory for is missing or empty, and what is saved is what there is.
bool holdsAll(BlobDict const& dict, int entries, char const* value) {
    Blob found;
    int whole = 0;
    for (int i = 0; i < entries; ++i) {
        whole += dict.get(blob("key " + std::to_string(i)), found) && found == blob(value) ? 1 : 0;
    }
    return whole == entries && dict.size() == static_cast<std::uint64_t>(entries);
}

bool sets(Place const&) {
    BlobDict dict;
    fill(dict, 100, "value");
    dict.rm(blob("key 7"));
    return holds(dict, 99, "value");
}
bool loads(Place const& place) {
    BlobDict const dict{Str(place / "dict")};
    return holds(dict, 10, "old");
}
bool saves(Place const& place) {
    BlobDict dict;
    dict.setPath(Str(place / "dict"));
    fill(dict, 20, "new");
    return holdsAll(dict, 20, "new") && dict.save();
}
bool writes(Place const& place) {
    BlobDict dict;
    dict.setPath(Str(place / "dict"));
    fill(dict, 20, "new");
    return holdsAll(dict, 20, "new") && dict.write();
}
bool storesBlobs(Place const& place) {
    {
        File file((place / "blobs").c_str(), File::FILE_WRITE | File::FILE_CRT);
        if (!file.isOpen() || !blob("one").write(file) || !blob("two").write(file)) return false;
        if (!file->flush()) return false;
    }
    File file((place / "blobs").c_str(), File::FILE_READ);
    Blob one;
    Blob two;
    return file.isOpen() && one.read(file) && two.read(file) && one == blob("one") && two == blob("two");
}

} // namespace

Scenarios storeScenarios() {
    return {
        {"Dict::set, rm, get", prepareNothing, sets},
        {"Dict::read", prepareDict, loads},
        {"Dict::save", prepareDict, saves},
        {"Dict::write", prepareDict, writes, Scenario::PIECES},
        {"Blob::write, read", prepareNothing, storesBlobs, Scenario::PIECES},
    };
}

/// \file
/// `Dict<Blob, Blob>`: a small dictionary of byte strings, kept in one file.
///
/// In memory it is a list of entries with different keys, the one that was added last at the front; every look-up goes
/// through the list. The file is nothing but the entries, each a key and a value in the stored form of a `Blob`, so files
/// can be joined by appending one to another. Nothing is saved but by `write`, not even at the end of a dictionary's life.
///
/// A reader puts each record it finds before the earlier ones. So every time a dictionary is loaded and saved the records
/// of its file come in reverse order; look-ups do not depend on it.
///
/// The members of the list are there too. What is changed through them `write` does not notice, and keys must stay
/// different.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  one thread at a time

#ifndef ZOR_BASIS_CONTAINERS_DICT_H
#define ZOR_BASIS_CONTAINERS_DICT_H

#include "zor_basis/containers/dict_entry.h"
#include "zor_basis/containers/sng_list.h"
#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/text/blob.h"

namespace ZOR_Basis {

template <class K, class V>
class Dict : public SngList<DictEntry<K, V>> {
public:
    using Entry = DictEntry<K, V>;

    /// Empty, without a path, as if it were saved.
    Dict() = default;
    /// Loads a file.
    /// \error without a file that can be read it is empty, and the next `write` makes the file
    Dict(Str const& path);
    /// Saves nothing.
    ~Dict() = default;

    /// Names another file; nothing is read or written.
    void setPath(Str const& path) { path_ = path; }

    /// \param out  receives the value; left alone where there is none
    bool get(K const& key, V& out) const;
    /// Stores a value. A new key comes first in the list; a key that is there keeps its place.
    /// \kept dict-01: a value that is there already makes the dictionary count as saved, whatever has not been saved
    ///     before: whoever needs that in the file calls `write` first
    void set(K const& key, V const& value);
    /// Removes a key. One that is not there changes nothing, nor does it need saving.
    void rm(K const& key);
    /// Removes everything, if there is anything.
    void clean();
    /// Removes the keys that another dictionary does not have.
    /// \kept dict-02: `write` does not notice it
    void intersect(Dict const& other);

    /// Replaces the entries by those of the file. Of a key that comes more than once the last value counts. A file that
    /// ends inside a record gives all records before.
    /// \kept dict-03: the list is in reverse order of the file
    /// \return false if the file cannot be opened; the dictionary is empty then, and needs saving if it was not before
    /// \cost linear; memory as the bytes arrive, whatever the lengths in the file announce
    bool read();
    /// Saves all entries from the front, if anything may have changed since the last time.
    /// \return false if the file cannot be opened or written; it is cut then, and the next `write` tries again
    bool write();

private:
    // A dictionary is not copied: two would write one file.
    Dict(Dict const&) : SngList<Entry>() {}
    Dict& operator=(Dict const&) { return *this; }

    Entry* find(K const& key) const;

    FPath path_;
    bool modified_ = false;
};

ZB_EXTERN_TEMPLATE Dict<Blob, Blob>;

} // namespace ZOR_Basis

#endif

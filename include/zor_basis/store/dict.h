/// \file
/// `Dict<Blob, Blob>`: a small dictionary of byte strings, stored in one file.
///
/// In memory it is a list of entries with distinct keys, the newest at the front. The file contains only the entries,
/// each a key and a value in the stored form of a `Blob`, so appending one file to another joins them. Only `save` and
/// `write` change the file; the destructor does not.
///
/// Save with `save`: whatever happens meanwhile, the file is then either the old one or the complete new one. `write`
/// truncates the file first and then fills it. If the disk is full, or the process ends in between, the old entries are
/// lost and the new ones incomplete.
///
/// The file has no signature, so a reader can judge it only by the lengths in it. Check `found` before saving to a file
/// that others may have damaged or replaced:
///
///     Dict<Blob, Blob> dict(path);
///     if (dict.found() == DICT_NOT_READ) return report(path); // saving would replace what could not be read
///     if (dict.found() == DICT_PART) return report(path, dict.understood()); // saving would cut the file there
///     dict.set(key, value);
///     return dict.save();
///
/// A reader puts each record in front of the earlier ones. So loading and saving a dictionary reverses the order of the
/// records in its file; look-ups do not depend on the order.
///
/// The members of the list are also available. `write` does not notice changes made through them, and keys must stay
/// distinct.
///
/// An index finds the keys of all but small dictionaries. It cannot notice changes made through pointers and iterators
/// into the list: once a caller has asked for one (`first`, `last`, `begin`, a `for` loop) or has changed the list
/// itself, look-ups search the list from its front, until the dictionary has been empty again.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread one thread at a time

#ifndef ZOR_BASIS_STORE_DICT_H
#define ZOR_BASIS_STORE_DICT_H

#include "zor_basis/containers/sng_list.h"
#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/store/blob.h"
#include "zor_basis/store/dict_entry.h"

#include <cstdint>

namespace ZOR_Basis {

class DictIndex;
class IFile;
class RecordReader;

/// The result of the last reading of a dictionary's file.
enum DictFile : int {
    DICT_NOT_READ, ///< nothing was read, or the file is there and could not be opened
    DICT_PART,    ///< bytes follow the last complete record: the file was cut or damaged, is not a dictionary, or could
                  ///< not be read to its end
    DICT_WHOLE,   ///< every byte belongs to a complete record; an empty file counts as whole
    DICT_MISSING, ///< there is no file, which `save` then makes
};

template <class K, class V>
class Dict : public SngList<DictEntry<K, V>> {
public:
    /// A key with its value.
    using Entry = DictEntry<K, V>;

    /// Constructs an empty dictionary without a path, which counts as saved.
    Dict() = default;
    /// Constructs a dictionary and loads a file by `read`.
    /// \error if the file cannot be opened the dictionary is empty, and the next `write` makes the file
    Dict(Str const& path);
    /// Saves nothing.
    ~Dict();

    /// Sets another file; nothing is read or written.
    void setPath(Str const& path) { path_ = path; }

    /// \param out  receives the value; unchanged if there is none
    /// \cost a look-up in the index, or a search of the list, whose time grows with the number of entries
    bool get(K const& key, V& out) const;
    /// Stores a value. A new key comes first in the list; an existing key keeps its place.
    /// \kept dict-01: storing a value that the key already has makes the dictionary count as saved, even if earlier
    ///     changes are not saved, and `write` then writes nothing. A caller that needs them in the file must call
    ///     `save`, or call `write` before
    /// \cost as `get`
    void set(K const& key, V const& value);
    /// Removes a key. A missing key changes nothing and requires no saving.
    /// \cost a search of the list; as `get` for a missing key
    void rm(K const& key);
    /// Removes all entries, if there are any.
    void clean();
    /// Removes the keys that another dictionary does not have.
    /// \kept dict-02: `write` does not notice the removal
    void intersect(Dict const& other);

    /// Replaces the entries by those of the file. If a key occurs more than once, the last value counts. A file that
    /// ends inside a record gives all records before it; `found` distinguishes it from a complete one.
    /// \kept dict-03: the order of the list is the reverse of the file's
    /// \return false if the file cannot be opened; the dictionary is then empty, and needs saving if it was not empty
    ///     before
    /// \cost linear; allocates memory as bytes arrive, whatever lengths the file announces
    bool read();
    /// The result of the last `read`, including the constructor's.
    DictFile found() const { return found_; }
    /// The number of bytes in the complete records at the front of that file, which is where reading stopped.
    std::uint64_t understood() const { return understood_; }

    /// Saves all entries from the front, whether or not anything has changed. They are written to a new file in the
    /// same folder, flushed to the disk, and renamed over the old file once they are whole.
    ///
    /// The new file has the permissions of the old one, and its owner and group as far as the system allows. A symbolic
    /// link stays: its target is replaced. Other hard links of the file keep the old content. A process that is killed
    /// meanwhile may leave a file ".zb-NUMBERS.tmp" in the folder; nothing else does.
    /// \return false if the new file cannot be made, written, flushed or renamed, and if `write` could not open the old
    ///     one; the old file is then unchanged
    /// \error the reason is the thread's last error (errno, `GetLastError`)
    /// \cost the time of the device, milliseconds on a disk, and room for both files
    bool save();
    /// Saves all entries from the front into the file itself, if anything may have changed since the last time. Prefer
    /// `save`: this function truncates the file before it writes, and does not ensure that the entries reach the disk.
    /// \return false if the file cannot be opened or written; the file is then incomplete, and the next `write` tries
    ///     again
    bool write();

private:
    // A dictionary cannot be copied: two would write the same file.
    Dict(Dict const&) : SngList<Entry>() {}
    Dict& operator=(Dict const&) { return *this; }

    using Unit = typename SngList<Entry>::Unit;

    Entry* find(std::uint64_t size, char const* key) const;
    Entry* find(K const& key) const { return find(key.size(), key.val()); }
    void add(Unit* unit);
    void drop(Unit* previous, Unit* unit);
    void load(RecordReader& records);
    bool put(IFile& file) const;
    DictIndex* index() const;
    void makeIndex() const;
    void dropIndex() const;

    FPath path_;
    bool modified_ = false;
    DictFile found_ = DICT_NOT_READ;
    std::uint64_t understood_ = 0;
    mutable DictIndex* index_ = nullptr; // owned; null: there is none yet
};

ZB_EXTERN_TEMPLATE Dict<Blob, Blob>;

} // namespace ZOR_Basis

#endif

/// \file
/// `Dict<Blob, Blob>`: a small dictionary of byte strings, kept in one file.
///
/// In memory it is a list of entries with different keys, the one that was added last at the front; every look-up goes
/// through the list. The file is nothing but the entries, each a key and a value in the stored form of a `Blob`, so files
/// can be joined by appending one to another. Only `save` and `write` change the file; the end of a dictionary's life does
/// not.
///
/// Save with `save`: whatever happens meanwhile, the file is then the old one or the whole new one. `write` empties the
/// file first and then fills it. On a full disk, or where the process ends in between, the old entries are lost and the new
/// ones cut.
///
/// The file has no mark of its own, so that a reader knows what it has read only by the lengths in it. Ask `found` before
/// saving to a file that others may have damaged or replaced:
///
///     Dict<Blob, Blob> dict(path);
///     if (dict.found() == DICT_PART) return report(path, dict.understood()); // saving would cut the file there
///     dict.set(key, value);
///     return dict.save();
///
/// A reader puts each record before the earlier ones. So every time a dictionary is loaded and saved the records of its
/// file come in reverse order; look-ups do not depend on it.
///
/// The members of the list are there too. `write` does not notice what is changed through them, and keys must stay
/// different.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  one thread at a time

#ifndef ZOR_BASIS_STORE_DICT_H
#define ZOR_BASIS_STORE_DICT_H

#include "zor_basis/containers/sng_list.h"
#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/store/blob.h"
#include "zor_basis/store/dict_entry.h"

#include <cstdint>

namespace ZOR_Basis {

class IFile;

/// What the last reading of a dictionary made of its file.
enum DictFile : int {
    DICT_NOT_READ, ///< nothing was read, or the file could not be opened
    DICT_PART, ///< there is more behind the last complete record: the file was cut, or damaged, or is no dictionary, or
               ///< could not be read to its end
    DICT_WHOLE, ///< every byte belongs to a complete record; so do those of an empty file
};

template <class K, class V>
class Dict : public SngList<DictEntry<K, V>> {
public:
    using Entry = DictEntry<K, V>;

    /// Empty, without a path, as if it were saved.
    Dict() = default;
    /// Loads a file by `read`.
    /// \error where the file cannot be opened it is empty, and the next `write` makes the file
    Dict(Str const& path);
    /// Saves nothing.
    ~Dict() = default;

    /// Names another file; nothing is read or written.
    void setPath(Str const& path) { path_ = path; }

    /// \param out  receives the value; left alone where there is none
    bool get(K const& key, V& out) const;
    /// Stores a value. A new key comes first in the list; a key that is there keeps its place.
    /// \kept dict-01: a value that is there already makes the dictionary count as saved, whatever has not been saved
    ///     before, and `write` then writes nothing. A caller that needs it in the file calls `save`, or `write` before
    void set(K const& key, V const& value);
    /// Removes a key. One that is not there changes nothing, nor does it need saving.
    void rm(K const& key);
    /// Removes everything, if there is anything.
    void clean();
    /// Removes the keys that another dictionary does not have.
    /// \kept dict-02: `write` does not notice it
    void intersect(Dict const& other);

    /// Replaces the entries by those of the file. Of a key that comes more than once the last value counts. A file that
    /// ends inside a record gives all records before; `found` tells it from a whole one.
    /// \kept dict-03: the list is in reverse order of the file
    /// \return false if the file cannot be opened; the dictionary is empty then, and needs saving if it was not before
    /// \cost linear; memory as the bytes arrive, whatever the lengths in the file announce
    bool read();
    /// What the last `read`, the constructor's included, made of the file.
    DictFile found() const { return found_; }
    /// The bytes of the complete records at the front of that file, which is where reading stopped.
    std::uint64_t understood() const { return understood_; }

    /// Saves all entries from the front, whether or not anything has changed. They are written to a new file in the same
    /// folder, flushed to the disk, and renamed over the old file once they are whole.
    ///
    /// The new file has the permissions of the old one, and its owner and group as far as the system allows. A symbolic
    /// link stays: what it leads to is replaced. Other hard links of the file keep the old content. A process that is killed
    /// meanwhile may leave a file ".zb-NUMBERS.tmp" in the folder; nothing else does.
    /// \return false if the new file cannot be made, written, flushed or renamed, and where `write` could not open the old
    ///     one; the old file is as it was then
    /// \error the reason is the thread's last error (errno, `GetLastError`)
    /// \cost the time of the device, milliseconds on a disk, and room for both files
    bool save();
    /// Saves all entries from the front into the file itself, if anything may have changed since the last time. Prefer
    /// `save`: this empties the file before it writes, and nothing makes sure that the entries reach the disk.
    /// \return false if the file cannot be opened or written; it is cut then, and the next `write` tries again
    bool write();

private:
    // A dictionary is not copied: two would write one file.
    Dict(Dict const&) : SngList<Entry>() {}
    Dict& operator=(Dict const&) { return *this; }

    Entry* find(K const& key) const;
    bool put(IFile& file) const;

    FPath path_;
    bool modified_ = false;
    DictFile found_ = DICT_NOT_READ;
    std::uint64_t understood_ = 0;
};

ZB_EXTERN_TEMPLATE Dict<Blob, Blob>;

} // namespace ZOR_Basis

#endif

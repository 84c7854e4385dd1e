/// \file
/// `FileEntry`: the record of one entry that a walk or a listing has found: directory, name, kind, size and time.

#ifndef ZOR_BASIS_FILES_FILE_ENTRY_H
#define ZOR_BASIS_FILES_FILE_ENTRY_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/text/buf_str.h"

#include <cstdint>

namespace ZOR_Basis {

/// \thread one thread at a time
class ZB_API FileEntry {
public:
    /// The kind of an entry.
    using EntryType = FStat::StatMode;

    /// Stores the arguments and joins the full path; the file system is not asked.
    /// \param size  counts bytes; 0 for a directory
    /// \param time  is that of the last write, in seconds since 1970 UTC
    FileEntry(EntryType type, Str const& dir, char const* name, std::uint64_t size, std::int64_t time);
    /// Stores directory, name and time, and reads kind and size from the file system (`Refresh`).
    FileEntry(Str const& dir, Str const& name, std::int64_t time);
    FileEntry(Str const& dir, char const* name, std::int64_t time);
    /// Splits the full path into directory and name, and reads kind and size from the file system. The time is 0.
    FileEntry(Str const& fullPath);
    FileEntry(FileEntry const& other) = default;
    FileEntry(FileEntry&& other) = default;
    FileEntry& operator=(FileEntry const& other) = default;
    FileEntry& operator=(FileEntry&& other) = default;

    /// The directory that contains the entry.
    FPath const& getDir() const { return dir_; }
    BufStr<255> const& getName() const { return name_; }
    FPath const& getFullPath() const { return fullPath_; }
    std::uint64_t getSize() const { return size_; }
    std::int64_t getTime() const { return time_; }
    EntryType getType() const { return type_; }
    bool exist() const { return type_ != FStat::ST_NONE; }
    bool isFile() const { return type_ == FStat::ST_FILE; }
    bool isDir() const { return type_ == FStat::ST_DIR; }

    /// Joins the full path from directory and name.
    void updateFullPath();

    /// Reads kind and size from the file system, with the platform layer as fallback. If the full path is empty it is
    /// joined first; otherwise directory and name are split from it.
    /// \kept entry-01: for a regular file the size is refreshed and the time is not; for an entry that is gone both
    ///     become 0; for any other entry only the size becomes 0
    /// \return whether the kind has changed, or the size of an entry that is a regular file now
    bool Refresh();

private:
    FPath dir_;
    BufStr<255> name_;
    FPath fullPath_;
    std::uint64_t size_ = 0;
    std::int64_t time_ = 0;
    EntryType type_ = FStat::ST_NONE;
};

} // namespace ZOR_Basis

#endif

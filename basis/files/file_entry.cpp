#include "zor_basis/files/file_entry.h"

namespace ZOR_Basis {

FileEntry::FileEntry(EntryType type, Str const& dir, char const* name, std::uint64_t size, std::int64_t time)
    : dir_(dir), name_(name), fullPath_(dir, name), size_(size), time_(time), type_(type) {}

FileEntry::FileEntry(Str const& dir, Str const& name, std::int64_t time) : dir_(dir), name_(name), time_(time) {
    Refresh();
}

FileEntry::FileEntry(Str const& dir, char const* name, std::int64_t time) : FileEntry(dir, Str(name), time) {}

FileEntry::FileEntry(Str const& fullPath) : fullPath_(fullPath) { Refresh(); }

void FileEntry::updateFullPath() { fullPath_.assign(dir_, name_); }

bool FileEntry::Refresh() {
    if (fullPath_.empty()) {
        updateFullPath();
    } else {
        FPath name;
        fullPath_.split(dir_, name);
        name_ = name;
    }
    EntryType const oldType = type_;
    std::uint64_t const oldSize = size_;
    FStat const entry(fullPath_.c_str());
    type_ = entry.type();
    // kept entry-01: the time is that of the listing, which callers compare entries by.
    size_ = entry.isFile() ? entry.size() : 0;
    if (!entry.exist()) time_ = 0;
    return type_ != oldType || (entry.isFile() && size_ != oldSize);
}

} // namespace ZOR_Basis

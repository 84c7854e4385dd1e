#include "zor_basis/walk/file_size_visitor.h"

#include "basis/files/system_calls.h"
#include "basis/ground/choices.h"
#include "basis/walk/passed_over.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/walk/file_iterator.h"

namespace ZOR_Basis {
namespace {

/// The statuses of a folder's entries, asked for by their names alone, so that the system need not go the whole path
/// for each. No caller's code runs between, so the folder cannot be another one meanwhile because of it.
class EntryStatus {
public:
    explicit EntryStatus(FPath const& folder) : path_(folder) {}
    EntryStatus(EntryStatus const&) = delete;
    EntryStatus& operator=(EntryStatus const&) = delete;
    ~EntryStatus() { pause(); }

    /// \return false where only the path can tell
    bool get(char const* name, xos_Stat& record) {
        if (folder_ == SystemCalls::NO_FOLDER) folder_ = systemCalls.openFolder(path_);
        return folder_ != SystemCalls::NO_FOLDER && systemCalls.statusIn(folder_, name, record);
    }
    /// Closes the folder until it is needed again: a walk may be as deep as the process can open listings.
    void pause() {
        if (folder_ != SystemCalls::NO_FOLDER) systemCalls.closeFolder(folder_);
        folder_ = SystemCalls::NO_FOLDER;
    }

private:
    FPath const& path_;
    SystemCalls::Folder folder_ = SystemCalls::NO_FOLDER;
};

/// Sums one folder.
class FolderSum {
public:
    explicit FolderSum(FPath const& path) : path_(path), status_(path) {}

    std::int64_t of(LookForType type) {
        FileIterator listing(path_, type, nullptr, nullptr);
        if (!listing.start(WITHOUT_WILDCARD)) return 0;
        std::int64_t total = 0;
        while (char const* const name = listing.next()) {
            if (!isPassedOver(name)) total += sizeOf(name);
        }
        return total;
    }

private:
    std::int64_t sizeOf(char const* name) {
        xos_Stat record{};
        if (!status_.get(name, record)) return sizeByPath(FPath(path_, name));
        switch (record.st_mode_ & MODE_TYPE) {
        case MODE_FILE:
            return record.st_size_;
        case MODE_LINK:
            return 0;
        default:
            status_.pause();
            return FolderSum(FPath(path_, name)).of(LOOK_BOTH);
        }
    }

    std::int64_t sizeByPath(FPath const& path) {
        FStat const entry(path);
        if (entry.isFile()) return static_cast<std::int64_t>(entry.size());
        status_.pause();
        return FileSizeVisitor::Get(path, DEEP);
    }

    FPath const& path_;
    EntryStatus status_;
};

} // namespace

bool FileSizeVisitor::perform(FileEntry* entry) {
    total_ += Get(entry->getFullPath(), recursive_);
    return true;
}

std::int64_t FileSizeVisitor::Get(Str const& path, bool recursive) {
    FPath const whole(path);
    FStat const entry(whole);
    // Listing a link would follow it out of the tree, or around in it forever.
    if (!entry.exist() || entry.type() == FStat::ST_LINK) return 0;
    if (entry.isFile()) return static_cast<std::int64_t>(entry.size());
    return FolderSum(whole).of(recursive ? LOOK_BOTH : LOOK_FILES);
}

} // namespace ZOR_Basis

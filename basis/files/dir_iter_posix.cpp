// The sibling is dir_iter_win.cpp.

#include "basis/files/dir_iter.h"

#include "basis/files/os_path_posix.h"
#include "basis/files/system_calls.h"
#include "basis/ground/wildcard.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <new>

namespace ZOR_Basis {
namespace {

class PosixDirIterW final : public SystemDirIterW {
public:
    PosixDirIterW(LookForType type, WChar const* path) : SystemDirIterW(type, path) {}
    ~PosixDirIterW() override { close(); }

    WChar const* next() override {
        if (first_) start();
        while (directory_ != nullptr && step()) {
            if (std::strcmp(entry_->d_name, ".") == 0 || std::strcmp(entry_->d_name, "..") == 0) continue;
            if (!isWanted(isDir())) continue;
            wideName(entry_->d_name, name_);
            return name_;
        }
        return nullptr;
    }

    bool isDir() override { return !isFile(); }
    bool isFile() override {
        // Without an entry, the answers are those of an empty file, as in the sibling before the first entry.
        if (entry_ == nullptr) return true;
        switch (entry_->d_type) {
        case DT_DIR:
            return false;
        case DT_LNK:
        case DT_UNKNOWN:
            return !S_ISDIR(status().st_mode);
        default:
            return true;
        }
    }
    std::int64_t time() override { return status().st_mtim.tv_sec; }
    std::uint64_t size() override { return isFile() ? static_cast<std::uint64_t>(status().st_size) : 0; }

private:
    void start() {
        first_ = false;
        appendWildCard();
        WcPath folder;
        WcPath pattern;
        path_.split(folder, pattern);
        bool const atRoot = path_.offsetName() == 1;
        narrowName(pattern, pattern_);
        directory_ = opendir(atRoot ? "/" : folder.empty() ? "." : static_cast<char const*>(OsPath(folder)));
        anyFits_ = false;
        if (directory_ == nullptr) lastError_ = errno == ENOENT ? PATH_NOT_FOUND : systemCalls.lastError();
    }

    /// Goes to the next entry that fits the wildcard, "." and ".." included, as they fit "*" in an empty directory.
    bool step() {
        do {
            errno = 0;
            entry_ = readdir(directory_);
            if (entry_ == nullptr) return end();
        } while (!matchesWildcard(pattern_.c_str(), static_cast<char const*>(entry_->d_name)));
        anyFits_ = true;
        examined_ = false;
        return true;
    }

    bool end() {
        if (lastError_ == 0)
            lastError_ = errno != 0 ? systemCalls.lastError() : anyFits_ ? NO_MORE_FILES : FILE_NOT_FOUND;
        return false;
    }

    /// The status of the entry or of its target; a link without a target counts as itself.
    struct stat const& status() {
        if (examined_) return status_;
        examined_ = true;
        status_ = {};
        if (entry_ == nullptr) return status_;
        int const folder = dirfd(directory_);
        if (fstatat(folder, entry_->d_name, &status_, 0) != 0) {
            fstatat(folder, entry_->d_name, &status_, AT_SYMLINK_NOFOLLOW);
        }
        return status_;
    }

    void close() override {
        if (directory_ != nullptr) closedir(directory_);
        directory_ = nullptr;
        entry_ = nullptr;
        examined_ = false;
    }

    DIR* directory_ = nullptr;
    dirent* entry_ = nullptr;
    BufStr<255> pattern_;
    WBStr name_;
    struct stat status_ {};
    bool examined_ = false;
    bool anyFits_ = false;
};

} // namespace

DirIterImplW* DirIterImplW::Make(LookForType type, WChar const* path) {
    return new (std::nothrow) PosixDirIterW(type, path);
}

} // namespace ZOR_Basis

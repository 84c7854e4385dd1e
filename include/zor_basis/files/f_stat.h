/// \file
/// `FStat`: a snapshot of one entry of the file system.
///
/// Kind, times and size come from one look and never change until the next `update`. A missing or unreachable entry
/// gives a cleared snapshot: `ST_NONE`, all numbers 0.
///
/// **Links.** Under Windows the system follows links. On Linux narrow paths do not, so that a link is `ST_LINK` and
/// neither a file nor a directory, while wide paths do.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)
/// \thread  one thread at a time for each object; the static forms are thread-safe

#ifndef ZOR_BASIS_FILES_F_STAT_H
#define ZOR_BASIS_FILES_F_STAT_H

#include "zor_basis/export.h"
#include "zor_basis/wide_char.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API FStat {
public:
    /// The kind of an entry.
    enum StatMode : std::uint32_t {
        ST_NONE = 0, ///< nothing there, or not examined yet
        ST_FILE = 1, ///< a regular file
        ST_DIR = 2,
        ST_LINK = 3,  ///< a symbolic link
        ST_OTHER = 4, ///< any other kind
    };

    /// Not examined yet.
    FStat() = default;
    /// `update` and `updateW` at once.
    FStat(char const* path) { update(path, true); }
    FStat(char const* path, bool platformFallback) { update(path, platformFallback); }
    FStat(WChar const* path) { updateW(path); }

    /// Takes a new snapshot.
    /// \param platformFallback  asks the platform layer where the system finds nothing: it may reach shares with other
    ///        credentials
    /// \return whether there is an entry; a null path is the empty one, which has none
    /// \cost one system call for an entry that is there
    bool update(char const* path) { return update(path, true); }
    bool update(char const* path, bool platformFallback);

    /// `update` that rides out transient errors of the network and of logging on: it tries again after a second for as
    /// long as the system's last error is one of these.
    ///
    /// | last error | given up |
    /// |---|---|
    /// | 64, the network name is gone | when more than 5 further tries have failed so |
    /// | 1326, logon failure | at the 101st, or at one that comes more than two minutes after the first failure |
    /// | 5, access denied | at the sixth |
    /// | any other | at once |
    ///
    /// On Linux ESTALE and the errors of unreachable hosts and networks stand for 64, EKEYREJECTED and its like for
    /// 1326, EACCES for 5.
    /// \cost blocks the calling thread for up to about two minutes
    bool updateMultiRetryNetwork(char const* path) { return updateMultiRetryNetwork(path, true); }
    bool updateMultiRetryNetwork(char const* path, bool platformFallback);

    /// Takes a new snapshot by a wide path, following links.
    /// \kept stat-02: the kind is `ST_DIR` or `ST_FILE`, whatever else there may be; the platform layer is not asked
    bool updateW(WChar const* path);

    StatMode type() const { return type_; }
    bool exist() const { return type_ != ST_NONE; }
    bool isFile() const { return type_ == ST_FILE; }
    bool isDir() const { return type_ == ST_DIR; }
    /// Bytes.
    std::uint64_t size() const { return size_; }
    /// Times in seconds since 1970 UTC. `created` is the time of the last change of status on Linux.
    std::int64_t modified() const { return modified_; }
    std::int64_t created() const { return created_; }
    std::int64_t accessed() const { return accessed_; }

    /// The same of a snapshot taken now, with the platform layer as fallback.
    static StatMode type(char const* path) { return FStat(path).type(); }
    static bool exist(char const* path) { return FStat(path).exist(); }
    static bool isFile(char const* path) { return FStat(path).isFile(); }
    static bool isDir(char const* path) { return FStat(path).isDir(); }
    static std::uint64_t size(char const* path) { return FStat(path).size(); }
    static std::int64_t modified(char const* path) { return FStat(path).modified(); }
    static std::int64_t created(char const* path) { return FStat(path).created(); }
    static std::int64_t accessed(char const* path) { return FStat(path).accessed(); }

private:
    StatMode type_ = ST_NONE;
    std::int64_t modified_ = 0;
    std::int64_t created_ = 0;
    std::int64_t accessed_ = 0;
    std::uint64_t size_ = 0;
};

static_assert(sizeof(FStat) == 40);

} // namespace ZOR_Basis

#endif

/// \file
/// `FStat`: the status of one entry of the file system, as a snapshot.
///
/// Kind, times and size come from one query and do not change until the next `update`. A missing or unreachable entry
/// gives a cleared snapshot: `ST_NONE`, all numbers 0.
///
///     FStat const stat(path);
///     if (stat.isFile() && stat.size() > 0) print(path);
///
/// **Links.** On Windows the system follows links. On Linux narrow paths do not follow a link, so that it is `ST_LINK`
/// and neither a file nor a directory; wide paths do.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)
/// \thread one thread at a time for each object; the static forms are thread-safe

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

    /// Constructs a cleared status; nothing is examined.
    FStat() = default;
    /// Construct the status and examine the entry, by `update` or `updateW`.
    FStat(char const* path) { update(path, true); }
    FStat(char const* path, bool platformFallback) { update(path, platformFallback); }
    FStat(WChar const* path) { updateW(path); }

    /// Takes a new snapshot, with the platform layer as fallback.
    bool update(char const* path) { return update(path, true); }
    /// Takes a new snapshot.
    /// \param platformFallback  asks the platform layer if the system finds nothing; that layer may reach shares with
    ///     other credentials
    /// \return whether the entry exists; a null path counts as empty, and nothing exists there
    /// \cost one system call for an existing entry
    bool update(char const* path, bool platformFallback);

    /// `update` that survives transient network and logon errors: it tries again after a second as long as the last
    /// error is one of these.
    ///
    /// | last error | the call gives up |
    /// |---|---|
    /// | 64, the network name is gone | when more than 5 further tries have failed with it |
    /// | 1326, logon failure | at the 101st failure, or at one more than two minutes after the first |
    /// | 5, access denied | at the sixth failure |
    /// | any other | immediately |
    ///
    /// On Linux, ESTALE and the errors for unreachable hosts and networks count as 64, EKEYREJECTED and its like as
    /// 1326, EACCES as 5.
    /// \cost blocks the calling thread for up to about two minutes
    bool updateMultiRetryNetwork(char const* path) { return updateMultiRetryNetwork(path, true); }
    bool updateMultiRetryNetwork(char const* path, bool platformFallback);

    /// Takes a new snapshot by wide path and follows links.
    /// \kept stat-02: the kind of an existing entry is `ST_DIR` or `ST_FILE`, whatever else it may be; the platform
    ///     layer is not asked
    bool updateW(WChar const* path);

    /// The kind of the entry, and questions about it; without an entry all are false.
    StatMode type() const { return type_; }
    bool exist() const { return type_ != ST_NONE; }
    bool isFile() const { return type_ == ST_FILE; }
    bool isDir() const { return type_ == ST_DIR; }
    /// The size in bytes.
    std::uint64_t size() const { return size_; }
    /// Times in seconds since 1970 UTC. `created` is the time of the last change of status on Linux.
    std::int64_t modified() const { return modified_; }
    std::int64_t created() const { return created_; }
    std::int64_t accessed() const { return accessed_; }

    /// The same for a snapshot taken by this call, with the platform layer as fallback.
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

#include "basis/system/mount_table_posix.h"

#include "basis/files/last_error.h"
#include "basis/files/os_path_posix.h"
#include "basis/ground/choices.h"
#include "basis/system/query_calls_posix.h"
#include "basis/system/text_parts.h"

#include <mntent.h>
#include <unistd.h>

#include <climits>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>

namespace ZOR_Basis {
namespace {

constexpr std::size_t LINE_ROOM = 8192;

constexpr char const* LOCAL_KINDS[] = {
    "bcachefs", "btrfs",    "cramfs", "erofs", "exfat", "ext2",   "ext3", "ext4",  "f2fs",    "fuseblk", "hfs",
    "hfsplus",  "iso9660",  "jfs",    "minix", "msdos", "nilfs2", "ntfs", "ntfs3", "overlay", "ramfs",   "reiserfs",
    "rootfs",   "squashfs", "tmpfs",  "ubifs", "udf",   "ufs",    "vfat", "xfs",   "zfs",
};

constexpr char const* WINDOWS_SHARES[] = {"cifs", "smb3", "smbfs"};
constexpr char const* NFS_SHARES[] = {"nfs", "nfs4"};

template <std::size_t N>
bool isOneOf(char const* const (&kinds)[N], Str const& kind) {
    for (char const* one : kinds) {
        if (kind == Str(one)) return true;
    }
    return false;
}

struct CloseTable {
    void operator()(std::FILE* table) const { endmntent(table); }
};

struct Free {
    void operator()(char* text) const { std::free(text); }
};

/// How much of the path a directory covers, with one more for the root, which covers all; 0 where the path lies
/// elsewhere.
std::size_t covered(char const* directory, char const* path) {
    std::size_t const n = std::strlen(directory);
    if (n == 1 && *directory == '/') return 1;
    bool const isWithin = std::strncmp(directory, path, n) == 0 && (path[n] == '/' || path[n] == '\0');
    return isWithin ? n + 1 : 0;
}

/// "/server/share" of "server:/share".
bool splitNfsSource(BufStr<255> const& source, FPath& path) {
    char const* const colon = std::strstr(source, ":/");
    if (colon == nullptr) return false;
    path = "//";
    path.BufStr<255>::add(source, static_cast<std::uint64_t>(colon - source.c_str()));
    path.BufStr<255>::add(colon + 1);
    return true;
}

} // namespace

FPath absolutePath(Str const& path) {
    FPath absolute(path);
    absolute.replaceBackSlashes();
    if (absolute.first() != '/') {
        char here[PATH_MAX];
        if (getcwd(here, sizeof here) == nullptr) return absolute;
        absolute = FPath(here, absolute);
    }
    // What does not exist yet is taken as it is, behind the longest part that does.
    for (std::uint64_t end = absolute.size(); end > 0; --end) {
        bool const isEnd = end == absolute.size() || absolute[end] == '/';
        if (!isEnd) continue;
        BufStr<255> front;
        setPart(front, absolute.c_str(), absolute.c_str() + end);
        std::unique_ptr<char, Free> const real(realpath(front, nullptr));
        if (real == nullptr) continue;
        BufStr<255> rest(absolute.c_str() + end);
        absolute = real.get();
        if (absolute == Str("/") && !rest.empty()) absolute.clear();
        absolute.BufStr<255>::add(rest);
        return absolute;
    }
    return absolute;
}

bool findMount(FPath const& path, Mount& mount) {
    std::unique_ptr<std::FILE, CloseTable> const table(setmntent(queryCalls.mountTable, "re"));
    if (table == nullptr) return false;
    std::size_t longest = 0;
    mntent entry;
    char line[LINE_ROOM];
    while (getmntent_r(table.get(), &entry, line, sizeof line) != nullptr) {
        std::size_t const length = covered(entry.mnt_dir, path);
        if (length == 0 || length < longest) continue;
        longest = length;
        mount.source = entry.mnt_fsname;
        mount.kind = entry.mnt_type;
        mount.directory = entry.mnt_dir;
    }
    return longest != 0 || refuse(Reason::NOT_FOUND);
}

bool isLocalKind(Str const& kind) { return isOneOf(LOCAL_KINDS, kind); }

bool networkPath(Mount const& mount, FPath& path) {
    if (isOneOf(NFS_SHARES, mount.kind)) return splitNfsSource(mount.source, path);
    if (!isOneOf(WINDOWS_SHARES, mount.kind)) return false;
    path.normalize(mount.source, NOT_A_URL);
    return true;
}

} // namespace ZOR_Basis

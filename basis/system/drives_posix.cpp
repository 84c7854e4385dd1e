// The sibling is drives_win.cpp.

#include "zor_basis/system/sys.h"

#include "basis/files/last_error.h"
#include "basis/system/mount_table_posix.h"

namespace ZOR_Basis {

bool Sys::isLocalDisk(Str const& path) {
    if (path.empty()) return false;
    Mount mount;
    return findMount(absolutePath(path), mount) && isLocalKind(mount.kind);
}

bool Sys::UnMap(Str const& path, FPath& unc) {
    if (path.empty()) return refuse(Reason::BAD_ARGUMENT);
    FPath const absolute = absolutePath(path);
    Mount mount;
    FPath share;
    if (!findMount(absolute, mount)) return false;
    if (!networkPath(mount, share)) return refuse(Reason::NOT_FOUND);
    char const* rest = absolute.c_str() + mount.directory.size();
    while (*rest == '/') ++rest;
    unc = share.add(rest);
    return true;
}

bool Sys::UnMap(Str const& path, Str const&, FPath& unc) { return UnMap(path, unc); }

bool Sys::UnMap(Str const& path, Str const&, Str const&, FPath& unc) { return UnMap(path, unc); }

bool Sys::UnMapLogin(Str const& path, FPath& unc) { return UnMap(path, unc); }

} // namespace ZOR_Basis

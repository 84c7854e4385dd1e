#include "basis/files/whole_entry.h"

#include "basis/files/last_error.h"
#include "basis/files/path_rules.h"
#include "basis/files/platform_flags.h"
#include "basis/ground/choices.h"
#include "basis/platform/xos_basics.h"
#include "zor_basis/files/dir.h"

namespace ZOR_Basis {

bool removeFile(char const* path) { return xos_FileRemove(PathRules::orEmpty(path), REMOVE_ALWAYS) == 0; }

bool copyFile(char const* dst, char const* src, bool overwrite) {
    return xos_FileCopy(PathRules::orEmpty(dst), PathRules::orEmpty(src), overwriteIf(overwrite)) == 0;
}

bool removeTree(char const* path) { return Dir::Rem(path, WITH_CONTENTS, WITHOUT_SECOND_FLAG); }

bool freeDestination(char const* path, FStat const& entry, bool overwrite) {
    if (!entry.exist()) return true;
    if (!overwrite) return refuse(Reason::ALREADY_THERE);
    return entry.isDir() ? removeTree(path) : removeFile(path);
}

bool linkOrCopy(char const* dst, char const* src) { return Dir::Link(dst, src) || copyFile(dst, src, OVERWRITING); }

} // namespace ZOR_Basis

#include "zor_basis/files/dir.h"

#include "basis/files/last_error.h"
#include "basis/files/path_rules.h"
#include "basis/files/platform_flags.h"
#include "basis/files/system_calls.h"
#include "basis/ground/choices.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/files/wc_path.h"

namespace ZOR_Basis {
namespace {

using PathRules::orEmpty;

/// What exists where a directory is wanted.
enum class Place { FREE, DIRECTORY, BLOCKED };

bool leadsToDirectory(char const* path) {
    xos_Stat record{};
    return systemCalls.statusOfTarget(path, record) && (record.st_mode_ & MODE_TYPE) == MODE_DIRECTORY;
}

/// Narrow paths: the platform layer makes directories.
struct Narrow {
    using Path = FPath;
    using Char = char;

    static Place look(FPath const& path) {
        FStat const entry(path.c_str());
        if (entry.isDir()) return Place::DIRECTORY;
        if (entry.isFile()) return Place::BLOCKED;
        bool const link = entry.type() == FStat::ST_LINK && leadsToDirectory(path);
        return link ? Place::DIRECTORY : Place::FREE;
    }
    static bool make(FPath const& path) { return xos_DirCreateEx(path, 0) == 0; }
};

/// Wide paths: the system makes directories, and any existing entry that is not one is in the way.
struct Wide {
    using Path = WcPath;
    using Char = WChar;

    static Place look(WcPath const& path) {
        FStat entry;
        if (!entry.updateW(path)) return Place::FREE;
        return entry.isDir() ? Place::DIRECTORY : Place::BLOCKED;
    }
    static bool make(WcPath const& path) { return systemCalls.makeDirectoryWide(path); }
};

template <class Kind>
bool isOrBecomesDirectory(typename Kind::Path const& path, Place place) {
    if (place == Place::BLOCKED) return refuse(Reason::NOT_DIRECTORY);
    return place == Place::DIRECTORY || Kind::make(path);
}

/// The end of the component behind the one that ends at `end`.
template <class Path>
std::uint64_t nextEnd(Path const& whole, std::uint64_t end) {
    do ++end;
    while (end < whole.size() && !whole.isSlash(end));
    return end;
}

/// Makes sure of a directory: of the deepest one upwards that is there or can be made, and then of those below it. No
/// recursion: a path may have more components than the stack has room for.
template <class Kind>
bool ensure(typename Kind::Path const& whole) {
    typename Kind::Path path(whole);
    for (Place place = Kind::look(path); !isOrBecomesDirectory<Kind>(path, place); place = Kind::look(path)) {
        std::uint64_t const name = path.offsetName();
        // Nothing is left to cut before a slash at the very front.
        if (place == Place::BLOCKED || name < 2) return false;
        path.cut(name - 1);
    }
    while (path.size() < whole.size()) {
        path.copy(static_cast<typename Kind::Char const*>(whole), nextEnd(whole, path.size()));
        if (!isOrBecomesDirectory<Kind>(path, Kind::look(path))) return false;
    }
    return true;
}

template <class Kind>
bool newFor(typename Kind::Path parent) {
    std::uint64_t const name = parent.offsetName();
    if (name == 0) return refuse(Reason::BAD_ARGUMENT);
    // kept dir-02: cutting before the first character means not cutting.
    if (name > 1) parent.cut(name - 1);
    return ensure<Kind>(parent);
}

template <class Kind>
bool makeNew(typename Kind::Path const& path, bool makeParents) {
    Place const place = Kind::look(path);
    if (place == Place::DIRECTORY) return true;
    if (place == Place::BLOCKED) return refuse(Reason::ALREADY_THERE);
    // kept dir-01: the parent of a bare name is the current directory, which cannot be made.
    return (!makeParents || newFor<Kind>(path)) && Kind::make(path);
}

} // namespace

bool Dir::Exist(char const* path) { return FStat::exist(path); }

bool Dir::New(char const* path, bool makeParents) { return makeNew<Narrow>(path, makeParents); }
bool Dir::NewFor(char const* path) { return newFor<Narrow>(path); }
bool Dir::NewW(WChar const* path, bool makeParents) { return makeNew<Wide>(path, makeParents); }
bool Dir::NewForW(WChar const* path) { return newFor<Wide>(path); }

bool Dir::Rem(char const* path, bool recursive, bool flagB) {
    FStat const entry(path);
    if (!entry.exist()) return true;
    if (entry.isFile()) return refuse(Reason::NOT_DIRECTORY);
    return xos_DirRemove(orEmpty(path), REMOVE_ALWAYS | flagIf(recursive, RECURSIVE) | flagIf(flagB, SECOND_FLAG)) == 0;
}

bool Dir::Copy(char const* dst, char const* src, bool recursive, bool overwrite, bool flagB) {
    std::uint32_t const flags =
        flagIf(overwrite, OVERWRITE) | flagIf(recursive, RECURSIVE) | flagIf(flagB, SECOND_FLAG);
    return xos_DirCopy(orEmpty(dst), orEmpty(src), flags) == 0;
}

bool Dir::Move(char const* dst, char const* src, bool overwrite, bool flagB) {
    std::uint32_t const flags = flagIf(overwrite, OVERWRITE) | flagIf(flagB, SECOND_FLAG);
    if (xos_DirMove(orEmpty(dst), orEmpty(src), flags) == 0) return true;
    bool const copied = xos_DirCopy(orEmpty(dst), orEmpty(src), flags | RECURSIVE) == 0;
    // kept dir-03: a caller that moves expects the source to be gone; it is better to send a job again than to find it
    // twice.
    KeepLastError const whyNotCopied;
    Rem(src, WITH_CONTENTS, flagB);
    return copied;
}

bool Dir::Link(char const* dst, char const* src) { return xos_FileHardLink(orEmpty(src), orEmpty(dst)) == 0; }

bool Dir::SplitCheck(char const* path, FPath& existing, FPath& rest) {
    // kept dir-04: if only a first component could exist, there is nothing to split off.
    constexpr std::uint64_t FIRST_INDEX = 1;
    existing.clear();
    rest.clear();
    FPath const whole(path);
    if (whole.size() < 3) return refuse(Reason::BAD_ARGUMENT);

    auto const exists = [&](std::uint64_t length) { return FStat::exist(existing.copy(whole.c_str(), length)); };
    existing = whole;
    std::uint64_t end = whole.size() - 1;
    while (whole.isSlash(end)) {
        if (!exists(end)) {
            existing.copy(whole.c_str(), end + 1);
            break;
        }
        if (--end == FIRST_INDEX) return false;
    }
    for (std::uint64_t slash = end - 1; slash > FIRST_INDEX; --slash) {
        if (!whole.isSlash(slash) || !exists(slash)) continue;
        rest.copy(whole.c_str() + slash + 1, end - slash);
        return true;
    }
    return false;
}

} // namespace ZOR_Basis

// The sibling is whole_file_posix.cpp.

#include "host/xos_basics/files/whole_file.h"

#include "host/xos_basics/files/entry_win.h"
#include "host/xos_basics/files/file_copy_win.h"

#include <algorithm>
#include <iterator>
#include <limits>

namespace host {

namespace {

/// Whether a file may be put in the place of what is there.
bool isReplaceable(EntryFacts const& present) { return !present.isDirectory() || failWith(ERROR_ACCESS_DENIED); }

bool isProgram(std::wstring const& path) {
    static constexpr wchar_t const* ENDINGS[] = {L".exe", L".com", L".bat", L".cmd"};
    if (path.size() < 4) return false;
    wchar_t const* const ending = path.c_str() + path.size() - 4;
    return std::any_of(std::begin(ENDINGS), std::end(ENDINGS), [&](wchar_t const* known) {
        return CompareStringOrdinal(ending, 4, known, 4, TRUE) == CSTR_EQUAL;
    });
}

std::uint16_t modeOf(EntryFacts const& facts, std::wstring const& path) {
    DWORD const attributes = facts.information.dwFileAttributes;
    unsigned const kind = facts.link ? 0xA000 : facts.isDirectory() ? 0x4000 : 0x8000;
    unsigned const write = (attributes & FILE_ATTRIBUTE_READONLY) != 0 ? 0 : 0222;
    unsigned const execute = facts.isDirectory() || isProgram(path) ? 0111 : 0;
    return static_cast<std::uint16_t>(kind | 0444 | write | execute);
}

/// Seconds since 1970 of a count of 100 ns since 1601.
std::int64_t secondsOf(FILETIME time) {
    auto const count = static_cast<std::int64_t>(std::uint64_t{time.dwHighDateTime} << 32 | time.dwLowDateTime);
    return count / 10'000'000 - 11'644'473'600;
}

} // namespace

bool removeFile(char const* path) {
    std::wstring wide;
    return systemPath(path, wide) && removeFileEntry(wide);
}

bool copyFile(char const* dst, char const* src, bool overwrite) {
    std::wstring from;
    std::wstring to;
    EntryFacts source{};
    EntryFacts present{};
    if (!systemPath(src, from) || !systemPath(dst, to) || !factsOf(from, source)) return false;
    if (source.isDirectory() || nameOffset(to) == to.size()) return failWith(ERROR_ACCESS_DENIED);
    if (factsOf(to, present)) {
        if (!overwrite) return failWith(ERROR_FILE_EXISTS);
        if (!isReplaceable(present)) return false;
        if (source.isSame(present)) return failWith(ERROR_SHARING_VIOLATION);
    } else if (!isMissing()) {
        return false;
    }
    return copyFileEntry(from, to, overwrite);
}

bool moveFile(char const* dst, char const* src, bool overwrite) {
    std::wstring from;
    std::wstring to;
    EntryFacts source{};
    EntryFacts present{};
    if (!systemPath(src, from) || !systemPath(dst, to) || !factsOf(from, source)) return false;
    if (source.isDirectory()) return failWith(ERROR_ACCESS_DENIED);
    if (!overwrite) return !factsOf(to, present) ? renameEntry(from, to, false) : failWith(ERROR_ALREADY_EXISTS);
    return (!factsOf(to, present) || isReplaceable(present)) && renameEntry(from, to, true);
}

bool linkFile(char const* src, char const* dst) {
    std::wstring from;
    std::wstring to;
    return systemPath(src, from) && systemPath(dst, to) && CreateHardLinkW(to.c_str(), from.c_str(), nullptr) != 0;
}

bool statusOf(char const* path, xos_Stat& record) {
    std::wstring full;
    EntryFacts facts{};
    if (!fullPath(path, full) || !factsOf(full, facts)) return false;
    BY_HANDLE_FILE_INFORMATION const& information = facts.information;
    record = {};
    record.st_dev_ = record.st_rdev_ = information.dwVolumeSerialNumber;
    record.st_mode_ = modeOf(facts, full);
    constexpr auto MOST = static_cast<DWORD>(std::numeric_limits<std::int16_t>::max());
    record.st_nlink_ = static_cast<std::int16_t>(std::min(information.nNumberOfLinks, MOST));
    record.st_size_ =
        facts.isDirectory()
            ? 0
            : static_cast<std::int64_t>(std::uint64_t{information.nFileSizeHigh} << 32 | information.nFileSizeLow);
    record.st_atime_ = secondsOf(information.ftLastAccessTime);
    record.st_mtime_ = secondsOf(information.ftLastWriteTime);
    record.st_ctime_ = secondsOf(information.ftCreationTime);
    return true;
}

} // namespace host

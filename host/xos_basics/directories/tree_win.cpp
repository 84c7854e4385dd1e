// The sibling is tree_posix.cpp.

#include "host/xos_basics/directories/tree.h"

#include "host/xos_basics/files/entry_win.h"
#include "host/xos_basics/files/file_copy_win.h"
#include "host/xos_basics/files/search_win.h"
#include "host/xos_basics/result.h"

#include <cstring>
#include <vector>

namespace host {

namespace {

/// The full path of an entry that can be removed: neither "." nor "..", nor a root.
bool entryPath(char const* path, std::wstring& full) {
    std::string text{path};
    cutEndSlashes(text);
    std::size_t const separator = text.find_last_of("/\\:");
    if (isDots(text.c_str() + (separator == std::string::npos ? 0 : separator + 1))) {
        return failWith(ERROR_INVALID_PARAMETER);
    }
    return fullPath(path, full) && (!isRoot(full) || failWith(ERROR_ACCESS_DENIED));
}

/// The directories from a tree's top to the current one, with those that are still to be visited.
class Descent {
public:
    explicit Descent(std::wstring top) : path_(std::move(top)) { levels_.push_back({path_.size(), {}}); }

    std::wstring const& path() const { return path_; }
    void add(wchar_t const* name) { levels_.back().waiting.emplace_back(name); }

    /// Goes down to the next directory that waits here.
    /// \return false: none is left
    bool enter() {
        std::vector<std::wstring>& waiting = levels_.back().waiting;
        if (waiting.empty()) return false;
        path_ = joined(path_, waiting.back().c_str());
        waiting.pop_back();
        levels_.push_back({path_.size(), {}});
        return true;
    }

    /// Goes up.
    /// \return false: this was the top
    bool leave() {
        levels_.pop_back();
        if (levels_.empty()) return false;
        path_.resize(levels_.back().length);
        return true;
    }

private:
    struct Level {
        std::size_t length;
        std::vector<std::wstring> waiting;
    };

    std::wstring path_;
    std::vector<Level> levels_;
};

/// Removes a tree; what cannot be removed stays, with the directories above it. No link is followed.
class TreeRemoval {
public:
    explicit TreeRemoval(std::wstring const& top) : descent_(top) {}

    bool run() {
        sweep();
        do {
            while (descent_.enter()) { sweep(); }
            if (!removeEmptyDirectory(descent_.path())) fail();
        } while (descent_.leave());
        return firstError_ == ERROR_SUCCESS || failWith(firstError_);
    }

private:
    void sweep() {
        Search search;
        if (!search.open(descent_.path())) {
            fail();
            return;
        }
        while (search.next()) {
            if (search.isDirectory()) {
                descent_.add(search.name());
            } else if (!removeFileEntry(joined(descent_.path(), search.name()))) {
                fail();
            }
        }
        if (GetLastError() != ERROR_NO_MORE_FILES) fail();
    }

    void fail() {
        if (firstError_ == ERROR_SUCCESS) firstError_ = GetLastError();
    }

    Descent descent_;
    DWORD firstError_ = ERROR_SUCCESS;
};

bool removeTree(std::wstring const& top) {
    return unlessMemoryLacks(false, [&] { return TreeRemoval{top}.run(); });
}

struct CopyRules {
    bool overwrite;
    bool recursive;
    /// Nobody else sees the target yet, so that its entries need no temporary names.
    bool unseen;
};

/// Recreates a link to a directory.
bool copyDirectoryLink(std::wstring const& from, std::wstring const& to, bool overwrite) {
    EntryFacts present{};
    if (factsOf(to, present)) {
        if (!overwrite || present.isDirectory()) return failWith(ERROR_ALREADY_EXISTS);
        if (!removeFileEntry(to)) return false;
    }
    return CreateDirectoryExW(from.c_str(), to.c_str(), nullptr) != 0;
}

class TreeCopy {
public:
    TreeCopy(std::wstring const& from, std::wstring to, CopyRules rules)
        : descent_(from), fromLength_(from.size()), to_(std::move(to)), rules_(rules) {}

    bool run() {
        bool here = copyEntries();
        while (here) {
            if (descent_.enter()) {
                here = makeDirectory() && copyEntries();
                continue;
            }
            if (isNew_.back()) keepFacts();
            isNew_.pop_back();
            if (!descent_.leave()) return true;
        }
        return false;
    }

private:
    std::wstring target() const { return to_ + descent_.path().substr(fromLength_); }

    bool makeDirectory() {
        bool const made = CreateDirectoryW(target().c_str(), nullptr) != 0;
        if (!made && (rules_.unseen || GetLastError() != ERROR_ALREADY_EXISTS)) return false;
        isNew_.push_back(made);
        return true;
    }

    bool copyEntries() {
        Search search;
        if (!search.open(descent_.path())) return false;
        while (search.next()) {
            if (!search.isDirectory()) {
                if (!copyEntry(search)) return false;
            } else if (rules_.recursive) {
                descent_.add(search.name());
            }
        }
        return GetLastError() == ERROR_NO_MORE_FILES;
    }

    bool copyEntry(Search const& search) {
        std::wstring const from = joined(descent_.path(), search.name());
        std::wstring const to = joined(target(), search.name());
        if ((search.entry().dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0) {
            return copyDirectoryLink(from, to, rules_.overwrite);
        }
        if (rules_.unseen) return copyToNewFile(from, to);
        EntryFacts present{};
        if (factsOf(to, present)) {
            if (!rules_.overwrite) return failWith(ERROR_FILE_EXISTS);
            if (present.isDirectory()) return failWith(ERROR_ACCESS_DENIED);
        }
        return copyFileEntry(from, to, rules_.overwrite);
    }

    void keepFacts() {
        WIN32_FILE_ATTRIBUTE_DATA source{};
        if (GetFileAttributesExW(descent_.path().c_str(), GetFileExInfoStandard, &source) != 0) {
            keepDirectoryFacts(target(), source);
        }
    }

    Descent descent_;
    std::size_t fromLength_;
    std::wstring to_;
    CopyRules rules_;
    /// Which of the target's directories down to the current one were made here; the top was, if it is still unseen.
    std::vector<bool> isNew_{rules_.unseen};
};

/// Lack of memory is told as any other failure, so that the caller can clear away what is there already.
bool copyTree(std::wstring const& from, std::wstring const& to, CopyRules rules) {
    return unlessMemoryLacks(false, [&] { return TreeCopy{from, to, rules}.run(); });
}

/// The physical path of a directory: no part of it is a link.
bool physicalPath(std::wstring const& directory, std::wstring& physical) {
    Handle const entry{CreateFileW(directory.c_str(), FILE_READ_ATTRIBUTES,
                                   FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr, OPEN_EXISTING,
                                   FILE_FLAG_BACKUP_SEMANTICS, nullptr)};
    if (!entry) return false;
    DWORD const size = GetFinalPathNameByHandleW(entry.get(), nullptr, 0, FILE_NAME_NORMALIZED);
    if (size == 0) return false;
    physical.resize(size);
    physical.resize(GetFinalPathNameByHandleW(entry.get(), physical.data(), size, FILE_NAME_NORMALIZED));
    return !physical.empty();
}

/// False, with the last error set, for a directory that is `other` or lies below it.
bool isOutside(std::wstring const& directory, EntryFacts const& other) {
    std::wstring path;
    if (!physicalPath(directory, path)) return false;
    for (;;) {
        EntryFacts facts{};
        if (factsOf(path, facts) && facts.isSame(other)) return failWith(ERROR_INVALID_PARAMETER);
        if (isRoot(path)) return true;
        path.resize(nameOffset(path) - 1);
        if (path.back() == L':') path += L'\\';
    }
}

std::wstring parentOf(std::wstring const& full) {
    std::wstring parent = full.substr(0, nameOffset(full));
    while (parent.size() > 1 && parent.back() == L'\\' && parent[parent.size() - 2] != L':') { parent.pop_back(); }
    return parent;
}

bool copyToNewDirectory(std::wstring const& from, std::wstring const& to, CopyRules rules) {
    std::wstring const temporary = temporaryBeside(to);
    if (CreateDirectoryW(temporary.c_str(), nullptr) == 0) return false;
    rules.unseen = true;
    if (copyTree(from, temporary, rules) && renameEntry(temporary, to, false)) return true;
    KeepLastError const keep;
    removeTree(temporary);
    return false;
}

} // namespace

bool createDirectory(char const* path) {
    std::wstring wide;
    return systemPath(path, wide) && CreateDirectoryW(wide.c_str(), nullptr) != 0;
}

bool removeDirectory(char const* path, bool recursive) {
    std::wstring full;
    EntryFacts facts{};
    if (!entryPath(path, full) || !factsOf(full, facts)) return false;
    if (facts.link) return removeFileEntry(full);
    if (!facts.isDirectory()) return failWith(ERROR_DIRECTORY);
    return recursive ? removeTree(full) : removeEmptyDirectory(full);
}

bool copyDirectory(char const* dst, char const* src, bool overwrite, bool recursive) {
    CopyRules const rules{overwrite, recursive, false};
    std::wstring from;
    std::wstring to;
    EntryFacts source{};
    EntryFacts present{};
    if (!fullPath(src, from) || !fullPath(dst, to) || !factsOf(from, source)) return false;
    bool const isDirectory = (source.information.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
    if (!isDirectory && !source.link) return failWith(ERROR_DIRECTORY);
    if (source.link) {
        return isDirectory ? copyDirectoryLink(from, to, overwrite) : copyFileEntry(from, to, overwrite);
    }
    if (!factsOf(to, present)) {
        return isMissing() && isOutside(parentOf(to), source) && copyToNewDirectory(from, to, rules);
    }
    if ((present.information.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) == 0) return failWith(ERROR_DIRECTORY);
    return isOutside(to, source) && copyTree(from, to, rules);
}

bool moveDirectory(char const* dst, char const* src, bool overwrite) {
    std::wstring from;
    std::wstring to;
    EntryFacts source{};
    EntryFacts present{};
    if (!entryPath(src, from) || !fullPath(dst, to) || !factsOf(from, source)) return false;
    if (!source.isDirectory() && !source.link) return failWith(ERROR_DIRECTORY);
    if (!factsOf(to, present)) return isMissing() && renameEntry(from, to, false);
    if (!overwrite) return failWith(ERROR_ALREADY_EXISTS);
    if (!present.isDirectory()) return failWith(ERROR_DIRECTORY);
    if (source.isSame(present)) return true;
    // What lies in the target would go with it.
    if (!isOutside(parentOf(from), present)) return false;
    // Put aside, the target can come back when the move fails after all.
    std::wstring const aside = temporaryBeside(to);
    if (!renameEntry(to, aside, false)) return false;
    bool const moved = renameEntry(from, to, false);
    if (moved && removeTree(aside)) return true;
    KeepLastError const keep;
    if (moved) renameEntry(to, from, false);
    renameEntry(aside, to, false);
    return false;
}

} // namespace host

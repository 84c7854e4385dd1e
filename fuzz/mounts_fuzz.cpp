// Any bytes as the system's table of mounts, and rows made of them: the mount of a path is the one that a plain reading
// finds.

#include "fuzz/target.h"

#include "basis/system/mount_table_posix.h"
#include "basis/system/query_calls_posix.h"

#include <sys/mman.h>
#include <unistd.h>

#include <cstring>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// A table in memory, in the place of the system's.
class Table {
public:
    explicit Table(std::string const& text) : file_(memfd_create("mounts", MFD_CLOEXEC)) {
        require(file_ >= 0 && write(file_, text.data(), text.size()) == static_cast<ssize_t>(text.size()));
        path_ = "/proc/self/fd/" + std::to_string(file_);
        queryCalls.mountTable = path_.c_str();
    }
    ~Table() {
        queryCalls.mountTable = systems_;
        close(file_);
    }
    Table(Table const&) = delete;
    Table& operator=(Table const&) = delete;

private:
    int const file_;
    std::string path_;
    char const* const systems_ = queryCalls.mountTable;
};

bool covers(std::string const& directory, std::string const& path) {
    if (directory == "/") return true;
    return path.compare(0, directory.size(), directory) == 0 &&
           (path.size() == directory.size() || path[directory.size()] == '/');
}

void requireOneThatCovers(std::string const& table, std::string const& path) {
    Table const placed(table);
    Mount mount;
    if (!findMount(FPath(path), mount)) return;
    require(covers(mount.directory.c_str(), path));
    FPath network;
    if (networkPath(mount, network)) { require(!network.empty() || mount.source.empty()); }
    isLocalKind(mount.kind);
}

struct Row {
    std::string source, directory, kind;
};

/// A field of a few letters, blanks and backslashes; these two stand in the table as their codes.
std::string field(RandomBytes& bytes, char const* front) {
    std::string text = front;
    for (std::uint64_t n = bytes.byte() % 6; n > 0; --n) text += "ab/ \\\t"[bytes.byte() % 6];
    return text;
}

std::string encoded(std::string const& text) {
    std::string codes;
    for (char const c : text) {
        codes += c == ' ' ? "\\040" : c == '\t' ? "\\011" : c == '\\' ? "\\134" : std::string(1, c);
    }
    return codes;
}

void requireTheLongest(RandomBytes bytes) {
    std::vector<Row> rows;
    std::string table;
    while (!bytes.isUsedUp() && rows.size() < 20) {
        rows.push_back({field(bytes, "s"), field(bytes, "/"), field(bytes, "k")});
        Row const& row = rows.back();
        table += encoded(row.source) + ' ' + encoded(row.directory) + ' ' + encoded(row.kind) + " rw 0 0\n";
    }
    Table const placed(table);
    for (std::string const path : {"/", "/a", "/a/b", "/ab/a", "/b a/b", "/a\\b/x"}) {
        Row const* expected = nullptr;
        for (Row const& row : rows) {
            if (!covers(row.directory, path)) continue;
            if (expected == nullptr || row.directory.size() >= expected->directory.size()) expected = &row;
        }
        Mount mount;
        require(findMount(FPath(path), mount) == (expected != nullptr));
        if (expected == nullptr) continue;
        require(expected->source == mount.source.c_str() && expected->kind == mount.kind.c_str());
        require(expected->directory == mount.directory.c_str());
    }
}

void runMounts(unsigned char const* data, std::size_t size) {
    std::string const table(reinterpret_cast<char const*>(data), size);
    for (char const* path : {"/", "/home", "/a/b/c"}) requireOneThatCovers(table, path);
    requireTheLongest(RandomBytes(data, size));
}

FuzzTarget const MOUNTS("mounts", runMounts);

} // namespace

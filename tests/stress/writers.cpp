#include "tests/stress/writers.h"

#include "tests/support/scratch.h"

#include <zor_basis/files.h>
#include <zor_basis/log.h>
#include <zor_basis/store/dict.h>

#include <xos_host.h>

#include <memory>
#include <sstream>

using namespace ZOR_Basis;

namespace stress {

std::string content(Desk const& desk, std::uint64_t round) {
    bool const isFirst = round % 2 == 0;
    return std::string(desk.size + (isFirst ? 0 : desk.size / 3), isFirst ? 'a' : 'b');
}

namespace {

bool isOneOfTwo(Desk const& desk, std::string const& text) {
    return text == content(desk, 0) || text == content(desk, 1);
}

void putBoth(Desk const& desk) {
    put(desk / "a", content(desk, 0));
    put(desk / "b", content(desk, 1));
}

std::string source(Desk const& desk, std::uint64_t round) { return desk / (round % 2 == 0 ? "a" : "b"); }

/// \return a complaint unless the sources are unchanged, the target is one of them, and nothing else is there but
///     temporary files
std::string targetComplaint(Desk const& desk) {
    if (textOf(desk / "a") != content(desk, 0) || textOf(desk / "b") != content(desk, 1)) return "a source changed";
    if (exists(desk / "target") && !isOneOfTwo(desk, textOf(desk / "target"))) return "the target is not whole";
    return "";
}

bool copies(Desk const& desk, std::uint64_t round) {
    return File::Copy((desk / "target").c_str(), source(desk, round).c_str(), true, false);
}

bool replaces(Desk const& desk, std::uint64_t round) {
    return File::Copy((desk / "new").c_str(), source(desk, round).c_str(), true, false) &&
           File::Move((desk / "target").c_str(), (desk / "new").c_str(), true, false);
}

std::string replacedComplaint(Desk const& desk) {
    if (exists(desk / "new") && !isOneOfTwo(desk, textOf(desk / "new"))) return "the source of a move is not whole";
    return targetComplaint(desk);
}

// One file that is moved to and fro.

void putOne(Desk const& desk) { put(desk / "a", content(desk, 0)); }

bool moves(Desk const& desk, std::uint64_t round) {
    std::string const from = desk / (round % 2 == 0 ? "a" : "b");
    std::string const to = desk / (round % 2 == 0 ? "b" : "a");
    return File::Move(to.c_str(), from.c_str(), false, false);
}

std::string movedComplaint(Desk const& desk) {
    if (exists(desk / "a") == exists(desk / "b")) return "the file is not at one of its two places";
    return textOf(desk / (exists(desk / "a") ? "a" : "b")) == content(desk, 0) ? "" : "the file is not whole";
}

bool movesFar(Desk const& desk, std::uint64_t round) {
    std::string const here = desk / "a";
    std::string const there = desk.elsewhere + "/a";
    return round % 2 == 0 ? File::Move(there.c_str(), here.c_str(), true, false)
                          : File::Move(here.c_str(), there.c_str(), true, false);
}

std::string movedFarComplaint(Desk const& desk) {
    std::string const there = desk.elsewhere + "/a";
    if (!exists(desk / "a") && !exists(there)) return "the file is lost";
    for (std::string const& path : {desk / "a", there}) {
        if (exists(path) && textOf(path) != content(desk, 0)) return "a file is not whole: " + path;
    }
    return "";
}

// A tree that is copied over itself.

constexpr int FILES = 10;

void putTree(Desk const& desk) {
    for (int i = 0; i < FILES; ++i) {
        std::string const folder = desk / ("source/" + std::to_string(i % 3));
        makeFolder(folder);
        put(folder + "/" + std::to_string(i), content(desk, static_cast<std::uint64_t>(i)));
    }
}

bool copiesTree(Desk const& desk, std::uint64_t) {
    return Dir::Copy((desk / "target").c_str(), (desk / "source").c_str(), true, true, false);
}

std::string treeComplaint(Desk const& desk) {
    for (int i = 0; i < FILES; ++i) {
        std::string const name = std::to_string(i % 3) + "/" + std::to_string(i);
        std::string const path = desk / ("target/" + name);
        std::string const expected = content(desk, static_cast<std::uint64_t>(i));
        if (textOf(desk / ("source/" + name)) != expected) return "a source changed: " + name;
        if (exists(path) && textOf(path) != expected) return "a copy is not whole: " + name;
    }
    return "";
}

// Dictionaries.

using BlobDict = Dict<Blob, Blob>;
constexpr int ENTRIES = 20;

Blob blob(std::string const& text) { return {text.size(), text.c_str()}; }

void fill(BlobDict& dict, Desk const& desk, std::uint64_t round) {
    for (int i = 0; i < ENTRIES; ++i) dict.set(blob("key " + std::to_string(i)), blob(content(desk, round)));
}

bool saves(Desk const& desk, std::uint64_t round) {
    BlobDict dict;
    dict.setPath(Str(desk / "dict"));
    fill(dict, desk, round);
    return dict.save();
}

bool writes(Desk const& desk, std::uint64_t round) {
    BlobDict dict;
    dict.setPath(Str(desk / "dict"));
    fill(dict, desk, round);
    return dict.write();
}

/// \param isWhole  whether all entries have to be there
std::string dictComplaint(Desk const& desk, bool isWhole) {
    if (!exists(desk / "dict")) return "";
    BlobDict const dict{Str(desk / "dict")};
    if (isWhole && (dict.found() != DICT_WHOLE || dict.size() != ENTRIES)) return "the dictionary is not whole";
    Blob first;
    for (int i = ENTRIES; i > ENTRIES - static_cast<int>(dict.size()); --i) {
        Blob found;
        if (!dict.get(blob("key " + std::to_string(i - 1)), found)) return "another entry than the first ones";
        if (first.size() == 0) first = found;
        if (!(found == first)) return "entries of two dictionaries in one file";
    }
    bool const isKnown = first == blob(content(desk, 0)) || first == blob(content(desk, 1));
    return dict.size() == 0 || isKnown ? "" : "an entry has another value";
}

std::string savedComplaint(Desk const& desk) { return dictComplaint(desk, true); }
std::string writtenComplaint(Desk const& desk) { return dictComplaint(desk, false); }

// A log. Each byte of "flushes" stands for a `flush` that has returned.

constexpr int LINES = 17;

std::string lineOf(std::uint64_t number) { return "line " + std::to_string(number) + std::string(number % 90, '.'); }

bool logs(Desk const& desk, std::uint64_t round) {
    // A log that is destroyed is closed some time later.
    static Log const& log = [&]() -> Log const& {
        xos_HostSetRoot(desk.folder.c_str());
        return *new Log("writer");
    }();
    for (std::uint64_t i = 0; i < LINES; ++i) log.out("%s", lineOf(round * LINES + i).c_str());
    if (!log.flush()) return false;
    std::ofstream(desk / "flushes", std::ios::app) << '.';
    return true;
}

std::string loggedComplaint(Desk const& desk) {
    std::istringstream text(textOf(desk / "tmp/zb_log/writer/0.log"));
    std::uint64_t lines = 0;
    for (std::string line; std::getline(text, line); ++lines) {
        if (!line.empty() && line.back() == '\r') line.pop_back();
        if (line == lineOf(lines)) continue;
        // Lines are written in blocks of 4,096 bytes, so that the last one may be cut between two of them.
        bool const isCut = text.eof() && lineOf(lines).compare(0, line.size(), line) == 0;
        return isCut ? "" : "a line is damaged or missing: " + line;
    }
    return lines >= LINES * textOf(desk / "flushes").size() ? "" : "lines are missing that were flushed";
}

void prepareNothing(Desk const&) {}

} // namespace

std::vector<Writer> const& writers() {
    static std::vector<Writer> const all = {
        {"copy", putBoth, copies, targetComplaint},
        {"replace", putBoth, replaces, replacedComplaint},
        {"move", putOne, moves, movedComplaint},
        {"move elsewhere", putOne, movesFar, movedFarComplaint},
        {"copy a tree", putTree, copiesTree, treeComplaint},
        {"save a dictionary", prepareNothing, saves, savedComplaint},
        {"write a dictionary", prepareNothing, writes, writtenComplaint},
        {"log", prepareNothing, logs, loggedComplaint},
    };
    return all;
}

} // namespace stress

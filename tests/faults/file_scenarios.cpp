#include "tests/faults/scenario.h"

#include <zor_basis/files.h>
#include <zor_basis/text/convert.h>

#include <cstring>
#include <memory>

using namespace ZOR_Basis;

namespace {

WBStr wide(std::string const& path) {
    WBStr units;
    Convert::Utf8ToWide(path.c_str(), units);
    return units;
}

/// Writes pieces of a content by which any file can be told from others.
bool writesTo(IFile* file) {
    if (file == nullptr) return false;
    for (int i = 0; i < 3; ++i) {
        if (file->write("line\n", 5) != 5) return false;
    }
    return file->flush();
}

bool readsFrom(IFile* file) {
    char buffer[100] = {};
    return file != nullptr && file->getline(buffer, sizeof buffer) != 0 && std::strncmp(buffer, "small", 5) == 0 &&
           file->seek(0, 1) >= 0 && file->read(buffer, 4) == 4 && std::memcmp(buffer, "mall", 4) == 0;
}

bool readsStream(IFile* file) {
    char buffer[100] = {};
    return file != nullptr && file->read(buffer, 5) == 5 && file->seek(0, 1) >= 0 && file->read(buffer, 4) == 4 &&
           std::memcmp(buffer, "mall", 4) == 0;
}

bool listsWide(Place const& place) {
    std::unique_ptr<DirIterImplW> const list(DirIterImplW::Make(LOOK_ALL, wide(place.path)));
    if (list == nullptr) return false;
    int count = 0;
    std::uint64_t size = 0;
    while (list->next() != nullptr) {
        ++count;
        size += list->size();
    }
    return list->lastError() == 18 && count == 4 && size == 100'005;
}

bool splitsPaths(Place const& place) {
    FPath existing;
    FPath rest;
    return Dir::SplitCheck((place / "d/e/no/such").c_str(), existing, rest) && existing == Str(place / "d/e") &&
           rest == Str("no/such");
}

bool normalises(Place const&) {
    FPath path;
    path.normalize((std::string(300, 'a') + "//b\\\\c/").c_str(), false);
    FPath const translated("/scsi0/x", TranslPath());
    FPath decoded("dir");
    decoded.addDecodedUrl(Str("a%20b"));
    return path.size() == 305 && !translated.empty() && decoded == Str("dira b");
}

#define IN_TREE(name, call)                                                                                            \
    {                                                                                                                  \
        name, prepareTree, [](Place const& place) -> bool { return call; }                                             \
    }

} // namespace

Scenarios fileScenarios() {
    auto constexpr PIECES = Scenario::PIECES;
    return {
        IN_TREE("File::New", File::New((place / "new").c_str(), false)),
        IN_TREE("File::New, parents", File::New((place / "x/y/new").c_str(), true)),
        IN_TREE("File::Rem", File::Rem((place / "a").c_str(), true, false)),
        IN_TREE("File::Copy", File::Copy((place / "copy").c_str(), (place / "b").c_str(), false, false)),
        IN_TREE("File::Copy, over", File::Copy((place / "a").c_str(), (place / "b").c_str(), true, false)),
        IN_TREE("File::Copy, parents", File::Copy((place / "x/y/copy").c_str(), (place / "a").c_str(), false, true)),
        IN_TREE("File::Move", File::Move((place / "moved").c_str(), (place / "b").c_str(), false, false)),
        IN_TREE("File::Move, over", File::Move((place / "a").c_str(), (place / "b").c_str(), true, false)),
        IN_TREE("File::Move, parents", File::Move((place / "x/moved").c_str(), (place / "b").c_str(), false, true)),
        IN_TREE("File::LinkOrCopy", File::LinkOrCopy((place / "link").c_str(), (place / "b").c_str(), false, false)),
        IN_TREE("File::LinkOrCopy, over", File::LinkOrCopy((place / "a").c_str(), (place / "b").c_str(), true, true)),
        {"File, written", prepareTree,
         [](Place const& place) { return writesTo(File((place / "n").c_str(), File::FILE_WRITE)); }, PIECES},
        {"File, written as a stream", prepareTree,
         [](Place const& place) { return writesTo(File((place / "n").c_str(), File::FILE_WRITE | File::FILE_CRT)); },
         PIECES},
        IN_TREE("File, read", readsFrom(File((place / "a").c_str(), File::FILE_READ))),
        IN_TREE("File, read as a stream", readsStream(File((place / "a").c_str(), File::FILE_READ | File::FILE_CRT))),
        IN_TREE("File, wide", readsFrom(File(wide(place / "a"), File::FILE_READ))),
        IN_TREE("Dir::Exist", Dir::Exist((place / "d").c_str())),
        IN_TREE("Dir::New", Dir::New((place / "new").c_str(), false)),
        IN_TREE("Dir::New, parents", Dir::New((place / "x/y/z").c_str(), true)),
        IN_TREE("Dir::NewFor", Dir::NewFor((place / "x/y/z").c_str())),
        IN_TREE("Dir::NewW", Dir::NewW(wide(place / "x/y/z"), true)),
        IN_TREE("Dir::NewForW", Dir::NewForW(wide(place / "x/y/z"))),
        IN_TREE("Dir::Rem", Dir::Rem((place / "empty").c_str(), false, false)),
        IN_TREE("Dir::Rem, recursive", Dir::Rem((place / "d").c_str(), true, false)),
        IN_TREE("Dir::Copy", Dir::Copy((place / "copy").c_str(), (place / "d").c_str(), true, false, false)),
        IN_TREE("Dir::Copy, over", Dir::Copy((place / "empty").c_str(), (place / "d").c_str(), true, true, false)),
        IN_TREE("Dir::Move", Dir::Move((place / "moved").c_str(), (place / "d").c_str(), false, false)),
        IN_TREE("Dir::Move, over", Dir::Move((place / "empty").c_str(), (place / "d").c_str(), true, false)),
        {"Dir::SplitCheck", prepareTree, splitsPaths},
        IN_TREE("FStat", FStat((place / "a").c_str()).size() == 5 && FStat::isDir((place / "d").c_str())),
        IN_TREE("FStat, wide", FStat(wide(place / "a").wstr()).size() == 5),
        IN_TREE("FStat::updateMultiRetryNetwork", FStat().updateMultiRetryNetwork((place / "a").c_str())),
        IN_TREE("FileEntry", FileEntry(Str(place / "a")).getSize() == 5),
        {"DirIteratorW", prepareTree, listsWide},
        {"FPath", prepareNothing, normalises},
    };
}

// Whatever fails leaves its reason as the last error, and nothing on the way out disturbs it.

#include "tests/system/reasons_test.h"

#include <zor_basis/files.h>
#include <zor_basis/flat.h>
#include <zor_basis/store/dict.h>
#include <zor_basis/system.h>
#include <zor_basis/walk.h>

#include "tests/support/http_server.h"

#include <memory>

using namespace ZOR_Basis;

namespace {

constexpr bool OVERWRITE = true;
constexpr bool MAKE_DIRS = true;
constexpr bool RECURSIVE = true;

constexpr int READ = File::FILE_READ;
constexpr int WRITE = File::FILE_WRITE;
constexpr int CRT = File::FILE_CRT;
/// The three backends: a mode and a flag.
constexpr struct Backend {
    int mode;
    bool flag;
} BACKENDS[] = {{0, false}, {CRT, true}, {CRT, false}};

using Wide = std::basic_string<WChar>;
Wide wide(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }

bool opens(std::string const& path, int mode, bool flag) { return File(path.c_str(), mode, flag).isOpen(); }

bool copies(Place const& in, char const* dst, char const* src, bool overwrite) {
    return File::Copy(in.at(dst).c_str(), in.at(src).c_str(), overwrite, false);
}
bool moves(Place const& in, char const* dst, char const* src, bool overwrite) {
    return File::Move(in.at(dst).c_str(), in.at(src).c_str(), overwrite, false);
}
bool copiesFolder(Place const& in, char const* dst, char const* src, bool overwrite) {
    return Dir::Copy(in.at(dst).c_str(), in.at(src).c_str(), RECURSIVE, overwrite, false);
}
bool movesFolder(Place const& in, char const* dst, char const* src) {
    return Dir::Move(in.at(dst).c_str(), in.at(src).c_str(), false, false);
}

/// Fails for one entry, with a last error of its own.
struct FailAt : FileVisitor {
    explicit FailAt(std::string const& path) : path_(path) {}
    bool perform(FileEntry* entry) override {
        return entry->getName() != Str("file") || File::Copy(entry->getFullPath(), path_.c_str(), true, false);
    }
    std::string path_;
};

template <class Visitor>
bool walks(Place const& in, char const* folder, Visitor&& visitor, bool deep, bool stopOnFalse) {
    return FileIterator(in.at(folder), LOOK_FILES, nullptr, nullptr).doIt(&visitor, deep, stopOnFalse);
}

bool gets(Place const& in, std::string const& url, char const* target = "new", bool overwrite = false) {
    return Url::Get(in.at(target).c_str(), url.c_str(), nullptr, nullptr, overwrite, false);
}

} // namespace

TEST(Reasons, of_files_that_cannot_be_made_or_removed) {
    expectReasons({
        Failure{{}, EISDIR, 5, [](auto& in) { return File::New(in.at("empty").c_str(), false); }},
        Failure{{}, ENOENT, 3, [](auto& in) { return File::New(in.at("no/file").c_str(), false); }},
        Failure{{}, ENOTDIR, 3, [](auto& in) { return File::New(in.at("file/x").c_str(), false); }},
        Failure{{}, ENOTDIR, 267, [](auto& in) { return File::New(in.at("file/x/y").c_str(), MAKE_DIRS); }},
        Failure{{}, EINVAL, 87, [](auto&) { return File::New("zb-bare-name", MAKE_DIRS); }},
        Failure{{}, ENOENT, 3, [](auto&) { return File::New(nullptr, false); }},
        Failure{{}, EIO, 31, [](auto& in) { return File::New(in.at("new").c_str(), false); }, "xos_FileOpen"},
        Failure{
            {}, EIO, 31, [](auto& in) { return File::New(in.at("a/new").c_str(), MAKE_DIRS); }, "xos_DirCreateEx", 9},
        Failure{{}, ENOENT, 2, [](auto& in) { return File::Rem(in.at("no").c_str(), true, false); }},
        Failure{{}, EISDIR, 5, [](auto& in) { return File::Rem(in.at("empty").c_str(), true, false); }},
        Failure{{}, EIO, 31, [](auto& in) { return File::Rem(in.at("file").c_str(), true, false); }, "xos_FileRemove"},
    });
}

TEST(Reasons, of_files_that_cannot_be_copied) {
    expectReasons({
        Failure{{}, EEXIST, 80, [](auto& in) { return copies(in, "other", "file", false); }},
        Failure{{}, EISDIR, 5, [](auto& in) { return copies(in, "empty", "file", OVERWRITE); }},
        Failure{{}, EISDIR, 5, [](auto& in) { return copies(in, "new", "empty", false); }},
        Failure{{}, EINVAL, 32, [](auto& in) { return copies(in, "file", "file", OVERWRITE); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return copies(in, "new", "no", false); }},
        Failure{{}, ENOENT, 3, [](auto& in) { return copies(in, "no/new", "file", false); }},
        Failure{{},
                EINVAL,
                87,
                [](auto& in) { return File::Copy("zb-bare", in.at("file").c_str(), OVERWRITE, MAKE_DIRS); }},
        Failure{{}, EIO, 31, [](auto& in) { return copies(in, "new", "file", false); }, "xos_FileCopy"},
    });
}

TEST(Reasons, of_files_that_cannot_be_moved_are_those_of_the_copy) {
    expectReasons({
        Failure{{}, EEXIST, 80, [](auto& in) { return moves(in, "other", "file", false); }},
        Failure{{}, EISDIR, 5, [](auto& in) { return moves(in, "empty", "file", OVERWRITE); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return moves(in, "new", "no", false); }},
        Failure{{}, ENOENT, 3, [](auto& in) { return moves(in, "no/new", "file", false); }},
        Failure{{},
                EINVAL,
                87,
                [](auto& in) { return File::Move("zb-bare", in.at("file").c_str(), OVERWRITE, MAKE_DIRS); }},
        // The source cannot be removed either.
        Failure{{}, ENOENT, 3, [](auto& in) { return moves(in, "no/new", "file", false); }, "xos_FileRemove"},
    });
}

TEST(Reasons, of_links_that_cannot_be_made) {
    auto const links = [](Place const& in, char const* dst, char const* src, bool overwrite) {
        return File::LinkOrCopy(in.at(dst).c_str(), in.at(src).c_str(), overwrite, false);
    };
    expectReasons({
        Failure{{}, EEXIST, 183, [=](auto& in) { return links(in, "other", "file", false); }},
        Failure{{}, ENOENT, 2, [=](auto& in) { return links(in, "new", "no", false); }},
        Failure{{}, ENOENT, 3, [=](auto& in) { return links(in, "no/new", "file", false); }},
        Failure{{}, EIO, 31, [=](auto& in) { return links(in, "other", "file", OVERWRITE); }, "xos_FileRemove"},
        Failure{{}, EIO, 31, [=](auto& in) { return links(in, "full", "file", OVERWRITE); }, "xos_DirRemove"},
        Failure{{}, EEXIST, 183, [](auto& in) { return Dir::Link(in.at("other").c_str(), in.at("file").c_str()); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return Dir::Link(in.at("new").c_str(), in.at("no").c_str()); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return zbLinkOrCopy(in.at("no").c_str(), in.at("new").c_str(), false); }},
        Failure{{},
                EISDIR,
                5,
                [](auto& in) { return zbLinkOrCopy(in.at("file").c_str(), in.at("full").c_str(), OVERWRITE); }},
    });
}

TEST(Reasons, of_files_that_cannot_be_opened) {
    for (Backend const& backend : BACKENDS) {
        SCOPED_TRACE(backend.mode + backend.flag);
        int const mode = backend.mode;
        bool const flag = backend.flag;
        expectReasons({
            Failure{{}, ENOENT, 2, [=](auto& in) { return opens(in.at("no"), READ | mode, flag); }},
            Failure{{}, ENOENT, 3, [=](auto& in) { return opens(in.at("no/x"), WRITE | mode, flag); }},
            Failure{{}, ENOTDIR, 3, [=](auto& in) { return opens(in.at("file/x"), WRITE | mode, flag); }},
            Failure{{}, EISDIR, 5, [=](auto& in) { return opens(in.at("empty"), WRITE | mode, flag); }},
            Failure{{}, ENOENT, 3, [=](auto&) { return opens("", READ | mode, flag); }},
        });
    }
    expectReasons({
        Failure{{}, EINVAL, 87, [](auto& in) { return opens(in.at("file"), CRT, true); }},
        Failure{{}, EIO, 31, [](auto& in) { return opens(in.at("file"), READ, true); }, "xos_FileOpen"},
        Failure{{}, ENOENT, 2, [](auto& in) { return File(wide(in.at("no")).c_str(), READ).isOpen(); }},
    });
}

TEST(Reasons, of_transfers) {
    for (Backend const& backend : BACKENDS) {
        SCOPED_TRACE(backend.mode + backend.flag);
        auto const onClosed = [=](Place const& in, auto call) {
            File file(in.at("no").c_str(), READ | backend.mode, backend.flag);
            clearSystemError();
            return call(*file.ptr());
        };
        bool const hasLines = backend.mode == 0 || backend.flag;
        char buffer[8];
        expectReasons({
            Failure{
                {}, EBADF, 6, [&](auto& in) { return onClosed(in, [&](IFile& f) { return f.read(buffer, 8) == 8; }); }},
            Failure{
                {}, EBADF, 6, [&](auto& in) { return onClosed(in, [&](IFile& f) { return f.write("x", 1) == 1; }); }},
            Failure{{}, EBADF, 6, [&](auto& in) { return onClosed(in, [&](IFile& f) { return f.flush(); }); }},
            Failure{{}, EBADF, 6, [&](auto& in) { return onClosed(in, [&](IFile& f) { return f.seek(0, 0) > 0; }); }},
            Failure{{},
                    hasLines ? EBADF : 0,
                    hasLines ? 6 : 0,
                    [&](auto& in) { return onClosed(in, [&](IFile& f) { return f.getline(buffer, 8) != 0; }); }},
        });
    }
    char buffer[8];
    expectReasons({
        Failure{{}, EBADF, 5, [](auto& in) { return File(in.at("file").c_str(), READ)->write("x", 1) == 1; }},
        Failure{{}, EBADF, 5, [&](auto& in) { return File(in.at("file").c_str(), WRITE)->read(buffer, 8) == 8; }},
        Failure{{}, EINVAL, 87, [](auto& in) { return File(in.at("file").c_str(), READ)->seek(7, 0) != 0; }},
        Failure{
            {}, EBADF, 6, [](auto& in) { return File(in.at("file").c_str(), READ | CRT, true)->write("x", 1) == 1; }},
        Failure{{},
                EIO,
                31,
                [&](auto& in) { return File(in.at("file").c_str(), READ)->read(buffer, 8) == 8; },
                "xos_FileReadEx"},
        Failure{{}, EIO, 31, [](auto& in) { return File(in.at("file").c_str(), WRITE)->flush(); }, "xos_FileFlush"},
    });
}

TEST(Reasons, are_not_given_at_the_end_of_a_file) {
    for (Backend const& backend : BACKENDS) {
        SCOPED_TRACE(backend.mode + backend.flag);
        Place const in;
        char buffer[8];
        File file(in.at("file").c_str(), READ | backend.mode, backend.flag);
        clearSystemError();
        EXPECT_EQ(file->read(buffer, 8), 4u);
        EXPECT_EQ(systemError(), 0);
    }
}

TEST(Reasons, of_folders_that_cannot_be_made_or_removed) {
    expectReasons({
        Failure{{}, EEXIST, 183, [](auto& in) { return Dir::New(in.at("file").c_str(), false); }},
        Failure{{}, EEXIST, 183, [](auto& in) { return Dir::New(in.at("file").c_str(), MAKE_DIRS); }},
        Failure{{}, ENOENT, 3, [](auto& in) { return Dir::New(in.at("no/x").c_str(), false); }},
        Failure{{}, ENOTDIR, 267, [](auto& in) { return Dir::New(in.at("file/x/y").c_str(), MAKE_DIRS); }},
        Failure{{}, EINVAL, 87, [](auto&) { return Dir::New("zb-bare-name", MAKE_DIRS); }},
        Failure{{}, EIO, 31, [](auto& in) { return Dir::New(in.at("new").c_str(), false); }, "xos_DirCreateEx"},
        Failure{{}, EINVAL, 87, [](auto&) { return Dir::NewFor("zb-bare-name"); }},
        Failure{{}, EINVAL, 87, [](auto&) { return Dir::NewFor(nullptr); }},
        Failure{{}, ENOTDIR, 267, [](auto& in) { return Dir::NewFor(in.at("file/x").c_str()); }},
        Failure{{}, EIO, 31, [](auto& in) { return Dir::NewFor(in.at("a/b/c").c_str()); }, "xos_DirCreateEx", 9},
        Failure{{}, EEXIST, 183, [](auto& in) { return Dir::NewW(wide(in.at("file")).c_str(), false); }},
        Failure{{}, ENOENT, 3, [](auto& in) { return Dir::NewW(wide(in.at("no/x")).c_str(), false); }},
        Failure{{}, ENOTDIR, 267, [](auto& in) { return Dir::NewForW(wide(in.at("file/x")).c_str()); }},
        Failure{{}, EINVAL, 87, [](auto&) { return Dir::NewForW(ZB_W("zb-bare-name")); }},
        Failure{{}, ENOTDIR, 267, [](auto& in) { return Dir::Rem(in.at("file").c_str(), RECURSIVE, false); }},
        Failure{{}, ENOTEMPTY, 145, [](auto& in) { return Dir::Rem(in.at("full").c_str(), false, false); }},
        Failure{{}, EIO, 31, [](auto& in) { return Dir::Rem(in.at("empty").c_str(), false, false); }, "xos_DirRemove"},
    });
}

TEST(Reasons, of_folders_that_cannot_be_copied_or_moved) {
    expectReasons({
        Failure{{}, ENOENT, 2, [](auto& in) { return copiesFolder(in, "new", "no", false); }},
        Failure{{}, ENOTDIR, 267, [](auto& in) { return copiesFolder(in, "new", "file", false); }},
        Failure{{}, EINVAL, 87, [](auto& in) { return copiesFolder(in, "full/new", "full", false); }},
        Failure{{}, EEXIST, 80, [](auto& in) { return copiesFolder(in, "full", "twin", false); }},
        Failure{{}, EEXIST, 80, [](auto& in) { return movesFolder(in, "full", "twin"); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return movesFolder(in, "new", "no"); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return movesFolder(in, "no/new", "full"); }},
        // The source cannot be removed either.
        Failure{{}, ENOENT, 2, [](auto& in) { return movesFolder(in, "no/new", "full"); }, "xos_DirRemove"},
    });
}

TEST(Reasons, of_questions_that_find_nothing) {
    expectReasons({
        Failure{{}, ENOENT, 2, [](auto& in) { return Dir::Exist(in.at("no").c_str()); }},
        Failure{{}, ENOENT, 3, [](auto& in) { return FStat::exist(in.at("no/x").c_str()); }},
        Failure{{}, ENOTDIR, 3, [](auto& in) { return FStat(in.at("file/x").c_str(), false).exist(); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return FStat(in.at("no").c_str(), false).exist(); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return FStat::size(in.at("no").c_str()) != 0; }},
        Failure{{}, ENOENT, 2, [](auto& in) { return FStat().updateMultiRetryNetwork(in.at("no").c_str()); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return FStat(wide(in.at("no")).c_str()).exist(); }},
        Failure{{}, ENOENT, 3, [](auto& in) { return FStat(wide(in.at("no/x")).c_str()).exist(); }},
        Failure{{},
                EINVAL,
                87,
                [](auto&) {
                    FPath a, b;
                    return Dir::SplitCheck("ab", a, b);
                }},
        Failure{{}, ENOENT, 2, [](auto& in) { return FileSizeVisitor::Get(in.at("no"), true) != 0; }},
    });
}

TEST(Reasons, of_walks) {
    FPath found;
    expectReasons({
        Failure{
            {}, ENOENT, 2, [](auto& in) { return FileIterator(in.at("no"), LOOK_ALL, nullptr, nullptr).start(false); }},
        Failure{{},
                ENOENT,
                2,
                [](auto& in) { return FileIterator(in.at("no"), LOOK_ALL, nullptr, nullptr).next() != nullptr; }},
        Failure{{},
                EIO,
                31,
                [](auto& in) { return FileIterator(in.at("full"), LOOK_ALL, nullptr, nullptr).next() != nullptr; },
                "xos_DirNextEx"},
        Failure{{},
                ENOENT,
                3,
                [](auto& in) { return DirIteratorW(LOOK_ALL, wide(in.at("no")).c_str())->next() != nullptr; }},
        // Other entries and the end of the listing come after the failure.
        Failure{{}, ENOENT, 2, [](auto& in) { return walks(in, "full", FailAt(in.at("no")), false, false); }},
        Failure{{}, ENOENT, 2, [](auto& in) { return walks(in, "", FailAt(in.at("no")), true, true); }},
        Failure{
            {},
            EEXIST,
            183,
            [](auto& in) { return walks(in, "full", FileCopyVisitor(in.scratch.path(), false, false), false, true); }},
        Failure{{},
                EEXIST,
                183,
                [](auto& in) { return walks(in, "full", FileMoveVisitor(in.scratch.path(), false), false, true); }},
        Failure{
            {},
            EIO,
            31,
            [](auto& in) { return walks(in, "full", FileCopyVisitor(in.scratch.path(), true, false), false, true); },
            "xos_FileRemove"},
        Failure{{},
                EIO,
                31,
                [](auto& in) { return walks(in, "full", FileDeleteVisitor(), false, true); },
                "xos_FileRemove"},
        Failure{{}, EEXIST, 183, [](auto& in) { return zbCheckRemoveFileDir(in.at("file").c_str(), false); }},
        Failure{
            {}, EIO, 31, [](auto& in) { return zbCheckRemoveFileDir(in.at("full").c_str(), true); }, "xos_DirRemove"},
    });
}

TEST(Reasons, of_dictionaries) {
    auto const saves = [](std::string const& path) {
        Dict<Blob, Blob> dict;
        dict.setPath(path);
        dict.set(Blob(3, "key"), Blob(5, "value"));
        clearSystemError();
        return dict.write();
    };
    auto const loads = [](std::string const& path) {
        Dict<Blob, Blob> dict;
        dict.setPath(path);
        return dict.read();
    };
    expectReasons({
        Failure{{}, ENOENT, 2, [=](auto& in) { return loads(in.at("no")); }},
        Failure{{}, EISDIR, 5, [=](auto& in) { return loads(in.at("empty")); }},
        Failure{{}, ENOENT, 3, [=](auto& in) { return saves(in.at("no/new")); }},
        Failure{{}, EISDIR, 5, [=](auto& in) { return saves(in.at("empty")); }},
        Failure{{}, EIO, 31, [=](auto& in) { return saves(in.at("new")); }, "xos_FileWriteEx"},
    });
}

TEST(Reasons, of_processes_and_libraries) {
    unsigned long process = 0;
    expectReasons({
        Failure{{}, EINVAL, 87, [](auto&) { return Process::Create(nullptr, nullptr, nullptr, nullptr); }},
        Failure{{},
                ENOENT,
                2,
                [](auto& in) { return Process::Create(in.at("no.exe").c_str(), nullptr, nullptr, nullptr); }},
        Failure{
            {}, ENOENT, 2, [&](auto&) { return Process::Create(nullptr, &process, "zb-no-such-program x", nullptr); }},
        Failure{{}, ESRCH, 87, [](auto&) { return Process::Wait(0); }},
        Failure{{}, ESRCH, 87, [](auto&) { return Process::Wait(0x7FFFFFF0); }},
        Failure{{}, ESRCH, 87, [](auto&) { return Process::Terminate(0x7FFFFFF0); }},
        Failure{{}, ENOENT, 126, [](auto&) { return Process::loadLib("zb-no-such-library") != nullptr; }},
        Failure{{}, EINVAL, 87, [](auto&) { return Process::loadLib("") != nullptr; }},
        Failure{{}, EINVAL, 87, [&](auto&) { return Process::ptrFunc("", &process) != nullptr; }},
        Failure{{}, ENOENT, 2, [](auto&) { return Process::ptrFunc("zb-nothing", nullptr) != nullptr; }},
        Failure{{}, EIO, 31, [](auto&) { return ZB_runCommand("echo", nullptr, true); }, "xos_ShellExecuteEx", 5},
        Failure{{},
                ENOENT,
                2,
                [](auto&) {
                    FPath path;
                    return ZB_Parse("  ", 2).getCleanFileName(path, true, false);
                }},
        Failure{{},
                EISDIR,
                5,
                [](auto& in) {
                    FPath path;
                    std::string const name = in.at("empty");
                    return ZB_Parse(name.c_str(), static_cast<int>(name.size())).getCleanFileName(path, true, false);
                }},
    });
}

TEST(Reasons, of_fetching) {
    HttpServer const server{{{"/page", always(answer("200 OK", "the page"))},
                             {"/gone", always(answer("404 Not Found", "no page"))},
                             {"/closed", always(answer("403 Forbidden", "no"))},
                             {"/secret", always(answer("401 Unauthorized", "no"))},
                             {"/broken", always(answer("500 Internal Server Error", "no"))},
                             {"/cut", always("HTTP/1.1 200 OK\r\nContent-Length: 100\r\n\r\nshort")},
                             {"/round", always(answer("302 Found", "", "Location: /round\r\n"))}}};
    std::string refused;
    {
        HttpServer const gone{{}};
        refused = gone.url("/page");
    }
    auto const fileUrl = [](std::string const& path) { return "file:///" + path.substr(path[0] == '/' ? 1 : 0); };
    expectReasons({
        Failure{{}, ENOENT, 2, [&](auto& in) { return gets(in, server.url("/gone")); }},
        Failure{{}, EACCES, 5, [&](auto& in) { return gets(in, server.url("/closed")); }},
        Failure{{}, EACCES, 5, [&](auto& in) { return gets(in, server.url("/secret")); }},
        Failure{{}, EPROTO, 12152, [&](auto& in) { return gets(in, server.url("/broken")); }},
        Failure{{}, ECONNRESET, 12152, [&](auto& in) { return gets(in, server.url("/cut")); }},
        Failure{{}, ELOOP, 12156, [&](auto& in) { return gets(in, server.url("/round")); }},
        Failure{{}, ECONNREFUSED, 12029, [&](auto& in) { return gets(in, refused); }},
        Failure{{}, EHOSTUNREACH, 12007, [&](auto& in) { return gets(in, "http://no-such-host.invalid/page"); }},
        Failure{{}, EPROTONOSUPPORT, 12006, [&](auto& in) { return gets(in, "gopher://localhost/page"); }},
        Failure{{}, EPROTONOSUPPORT, 12006, [&](auto& in) { return gets(in, "nonsense"); }},
        Failure{{}, EEXIST, 183, [&](auto& in) { return gets(in, server.url("/page"), "file"); }},
        Failure{{}, EISDIR, 5, [&](auto& in) { return gets(in, server.url("/page"), "empty", OVERWRITE); }},
        Failure{{}, ENOENT, 3, [&](auto& in) { return gets(in, server.url("/page"), "no/new"); }},
        Failure{{},
                EINVAL,
                87,
                [&](auto&) {
                    return Url::Get("zb-bare", server.url("/page").c_str(), nullptr, nullptr, OVERWRITE, MAKE_DIRS);
                }},
        Failure{{},
                EINVAL,
                87,
                [](auto& in) { return Url::Get(in.at("new").c_str(), nullptr, nullptr, nullptr, false, false); }},
        Failure{{}, ENOENT, 2, [&](auto& in) { return gets(in, fileUrl(in.at("no"))); }},
        Failure{{}, EISDIR, 5, [&](auto& in) { return gets(in, fileUrl(in.at("empty"))); }},
        Failure{{}, EINVAL, 87, [&](auto& in) { return gets(in, "file:no-slash"); }},
        Failure{{}, EIO, 31, [&](auto& in) { return gets(in, server.url("/page")); }, "xos_URLGet"},
    });
}

TEST(Reasons, of_logging_on) {
    struct None : SysHdl {
    } none;
    expectReasons({
        Failure{{}, EINVAL, 87, [](auto&) { return Sys::loginUser("", "secret", true) != nullptr; }},
        Failure{{}, EBADF, 6, [&](auto&) { return Sys::impersonate(&none); }},
    });
}

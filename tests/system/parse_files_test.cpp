#include <zor_basis/files/f_path.h>
#include <zor_basis/system/parse.h>

#include "tests/support/scratch.h"
#include "tests/support/scratch_root.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

namespace fs = std::filesystem;
using namespace ZOR_Basis;

namespace {

/// A file and a directory beneath the root.
struct ParseFiles : testing::Test {
    ParseFiles() {
        fs::create_directories(scratchRoot() / "list" / "dir");
        put((scratchRoot() / "list" / "file 1").string(), "text");
    }
    ~ParseFiles() override { fs::remove_all(scratchRoot() / "list"); }

    std::string const root = scratchRoot().generic_string();
};

bool next(ZB_Parse& parse, FPath& path, bool fileOnly, bool forwardSlashes = false) {
    return parse.getCleanFileName(path, fileOnly, forwardSlashes);
}

} // namespace

TEST_F(ParseFiles, are_found) {
    struct Case {
        Row row;
        std::string line;
        bool fileOnly, found;
        std::string path;
        bool forwardSlashes = false;
    };
    for (Case const& c : {
             Case{{}, "/scsi0/list/file 1\n", true, true, root + "/list/file 1"},
             Case{{}, "/JS_Root/list/file 1", false, true, root + "/list/file 1"},
             Case{{}, "\r\n  " + root + "/list/file 1\r\n", true, true, root + "/list/file 1"},
             Case{{}, "\\scsi0\\list\\file 1\n", true, true, root + "\\list\\file 1"},
             Case{{}, "\\scsi0\\list\\file 1\n", true, true, root + "/list/file 1", true},
             Case{{}, "/scsi0/list/dir\n", true, false, root + "/list/dir"},
             Case{{}, "/scsi0/list/dir\n", false, true, root + "/list/dir"},
             Case{{}, "/scsi0/list/gone\n", false, false, root + "/list/gone"},
             Case{{}, "\\scsi0\\list\\gone", false, false, root + "/list/gone", true},
             Case{{}, "scsi0/list/file 1", true, false, "scsi0/list/file 1"},
             Case{{}, std::string("\0x", 2), false, false, ""},
         }) {
        SCOPED_TRACE(c.row);
        ZB_Parse parse(c.line.data(), static_cast<int>(c.line.size()));
        FPath path("before");
        EXPECT_EQ(next(parse, path, c.fileOnly, c.forwardSlashes), c.found);
        EXPECT_EQ(std::string(path.c_str()), c.path);
        EXPECT_EQ(path.size(), c.path.size());
    }
}

TEST_F(ParseFiles, are_read_one_after_the_other) {
    std::string const text = "/scsi0/list/file 1\n\n/scsi0/list/gone\r\n/scsi0/list/dir\n\n";
    ZB_Parse parse(text.data(), static_cast<int>(text.size()));
    FPath path;
    EXPECT_TRUE(next(parse, path, false));
    EXPECT_FALSE(next(parse, path, false));
    EXPECT_TRUE(next(parse, path, false));
    EXPECT_FALSE(next(parse, path, false));
    EXPECT_EQ(std::string(path.c_str()), root + "/list/dir") << "left as it was at the end";
    EXPECT_TRUE(parse.isDataEnd());
}

TEST_F(ParseFiles, have_names_of_255_bytes_at_most) {
    std::string const end = "file 1";
    for (std::size_t const size : {254U, 255U, 256U, 257U}) {
        SCOPED_TRACE(size);
        std::string path = root + "/list";
        while (path.size() < 240) path += "/.";
        path += std::string(size - path.size() - end.size(), '/') + end;
        ASSERT_EQ(path.size(), size);
        ZB_Parse parse(path.data(), static_cast<int>(path.size()));
        FPath found;
        EXPECT_EQ(next(parse, found, true), size <= 255);
        EXPECT_EQ(std::string(found.c_str()), path.substr(0, 255));
        EXPECT_EQ(parse.isDataEnd(), size <= 255);
    }
}

// What Windows knows of a file besides its content: attributes, who has it open, and the path of an open entry.

#include "basis/files/opened_path_win.h"
#include "tests/store/dict_files.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

std::string const NEW = fileOf({{"a", "1"}});

struct DictSaveWin : testing::Test {
    DictSaveWin() {
        put(path, "old");
        dict.setPath(Str(path));
        dict.set(blob("a"), blob("1"));
    }

    Scratch scratch;
    std::string const path = scratch / "file";
    BlobDict dict;
};

} // namespace

TEST_F(DictSaveWin, keeps_attributes) {
    for (DWORD attribute : {FILE_ATTRIBUTE_HIDDEN, FILE_ATTRIBUTE_SYSTEM, FILE_ATTRIBUTE_NORMAL}) {
        ASSERT_TRUE(SetFileAttributesA(path.c_str(), attribute));
        DWORD const before = GetFileAttributesA(path.c_str());
        EXPECT_TRUE(dict.save());
        EXPECT_EQ(GetFileAttributesA(path.c_str()) & ~DWORD{FILE_ATTRIBUTE_ARCHIVE},
                  before & ~DWORD{FILE_ATTRIBUTE_ARCHIVE});
    }
    EXPECT_EQ(textOf(path), NEW);
}

TEST_F(DictSaveWin, does_not_replace_what_may_not_be_written) {
    ASSERT_TRUE(SetFileAttributesA(path.c_str(), FILE_ATTRIBUTE_READONLY));
    EXPECT_FALSE(dict.save());
    EXPECT_EQ(GetLastError(), DWORD{ERROR_ACCESS_DENIED});
    EXPECT_EQ(textOf(path), "old");
    EXPECT_EQ(scratch.content(), Names{"file"});
    ASSERT_TRUE(SetFileAttributesA(path.c_str(), FILE_ATTRIBUTE_NORMAL));
}

TEST_F(DictSaveWin, leaves_a_file_that_another_holds) {
    for (DWORD share : {DWORD{0}, DWORD{FILE_SHARE_READ}, DWORD{FILE_SHARE_READ | FILE_SHARE_WRITE}}) {
        HANDLE const held =
            CreateFileA(path.c_str(), GENERIC_READ, share, nullptr, OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
        ASSERT_NE(held, INVALID_HANDLE_VALUE);
        EXPECT_FALSE(dict.save()) << share;
        DWORD const reason = GetLastError();
        EXPECT_TRUE(reason == ERROR_SHARING_VIOLATION || reason == ERROR_ACCESS_DENIED) << reason;
        CloseHandle(held);
        EXPECT_EQ(textOf(path), "old");
        EXPECT_EQ(scratch.content(), Names{"file"});
    }
    EXPECT_TRUE(dict.save());
}

TEST_F(DictSaveWin, replaces_no_device) {
    dict.setPath("NUL");
    EXPECT_FALSE(dict.save());
    EXPECT_EQ(GetLastError(), DWORD{ERROR_INVALID_PARAMETER});
}

TEST_F(DictSaveWin, knows_the_path_of_an_open_entry) {
    FPath found;
    ASSERT_TRUE(openedPath((scratch.path() + "/./file").c_str(), found));
    EXPECT_EQ(textOf(found.c_str()), "old");
    EXPECT_EQ(found.c_str()[1], ':') << found.c_str() << ": as it is written everywhere";
    EXPECT_STREQ(found.c_str() + found.size() - 5, "\\file");
    EXPECT_FALSE(openedPath((scratch / "missing").c_str(), found));
    EXPECT_EQ(GetLastError(), DWORD{ERROR_FILE_NOT_FOUND});
}

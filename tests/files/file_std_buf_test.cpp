#include <zor_basis/files/file.h>

#include "basis/files/file_backends.h"
#include "tests/support/table.h"

#include "tests/files/opened_file.h"

#include <gtest/gtest.h>

#include <memory>

using namespace ZOR_Basis;

namespace {

struct FileStdBufStreams : CallsOfFiles {};

} // namespace

TEST_F(FileStdBufStreams, build_the_mode_text_of_a_stream) {
    struct Case {
        Row row;
        int mode;
        char const* text;
    };
    for (Case const& c : {
             Case{{}, 0x001, "rR"},
             Case{{}, 0x002, "wR"},
             Case{{}, 0x004, "a+R"},
             Case{{}, 0x003, "r+R"},
             Case{{}, 0x00B, "w+R"},
             Case{{}, 0x009, "rR"},
             Case{{}, 0x005, "rR"},
             Case{{}, 0x007, "r+R"},
             Case{{}, 0x006, "wR"},
             Case{{}, 0x00A, "wR"},
             Case{{}, 0x00C, "a+R"},
             Case{{}, 0x021, "rS"},
             Case{{}, 0x031, "rSb"},
             Case{{}, 0x011, "rRb"},
             Case{{}, 0x3A, "wSb"},
             Case{{}, 0x3B, "w+Sb"},
             Case{{}, 0x33, "r+Sb"},
             Case{{}, 0x34, "a+Sb"},
         }) {
        SCOPED_TRACE(c.row);
        static std::string handed;
        handed.clear();
        systemCalls.openStream = [](char const*, char const* mode) -> std::FILE* {
            handed = mode;
            return nullptr;
        };
        systemCalls.openStreamWide = [](WChar const*, char const* mode) -> std::FILE* {
            handed = mode;
            return nullptr;
        };
        File file;
        EXPECT_FALSE(file.open("x", c.mode | File::FILE_CRT, true));
        EXPECT_EQ(handed, c.text);
        handed.clear();
        File wideFile;
        EXPECT_FALSE(wideFile.openW(ZB_W("x"), c.mode));
        EXPECT_EQ(handed, c.text);
    }
}

TEST_F(FileStdBufStreams, open_no_stream_without_any_access) {
    for (int mode : {0, 0x008, 0x010, 0x020, 0x038, 0x080, 0x200}) {
        File file;
        EXPECT_FALSE(file.open(at("f").c_str(), mode | File::FILE_CRT, true)) << mode;
        ASSERT_NE(file.ptr(), nullptr);
        EXPECT_TRUE(!*file.ptr());
        EXPECT_FALSE(File(wide(at("f")).c_str(), mode).isOpen()) << mode;
    }
    EXPECT_FALSE(exists(at("f")));
}

TEST_F(FileStdBufStreams, Kept_file_03_truncate_with_every_stream_for_writing_alone) {
    put(at("f"), "before");
    File file;
    ASSERT_TRUE(file.open(at("f").c_str(), 0x36 | File::FILE_CRT, true));
    file.close();
    EXPECT_EQ(textOf(at("f")), "");
    put(at("f"), "before");
    ASSERT_TRUE(file.open(at("f").c_str(), 0x34 | File::FILE_CRT, true)) << "append alone";
    file->write("+", 1);
    file.close();
    EXPECT_EQ(textOf(at("f")), "before+");
}

TEST_F(FileStdBufStreams, open_streams_by_wide_paths) {
    {
        File file(wide(at("f")).c_str(), WRITE);
        ASSERT_TRUE(file.isOpen());
        EXPECT_NE(dynamic_cast<FileStdBuf*>(file.ptr()), nullptr);
        EXPECT_EQ(file->write("12", 2), 2u);
    }
    EXPECT_EQ(textOf(at("f")), "12");
    File file;
    EXPECT_TRUE(file.openW(wide(at("f")).c_str(), READ));
    file.close();
    EXPECT_FALSE(file.openW(wide(at("missing")).c_str(), READ));
    EXPECT_NE(file.ptr(), nullptr);
    file.close();
    EXPECT_FALSE(file.openW(nullptr, READ));
}

TEST_F(FileStdBufStreams, Kept_file_05_leave_open_what_is_held_when_a_wide_path_is_opened) {
    File file(wide(at("f")).c_str(), WRITE);
    std::unique_ptr<IFile> const before(file.ptr());
    ASSERT_TRUE(file.openW(wide(at("g")).c_str(), WRITE));
    EXPECT_NE(file.ptr(), before.get());
    EXPECT_TRUE(before->isOpen());
    EXPECT_EQ(before->write("1", 1), 1u);
}

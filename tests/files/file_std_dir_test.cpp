#include <zor_basis/files/file.h>

#include "tests/files/opened_file.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileStdDirDescriptors : CallsOfFiles {};

} // namespace

TEST_F(FileStdDirDescriptors, append_at_the_end_whatever_the_position) {
    for (bool platform : {true, false}) {
        put(at("f"), "abc");
        File file;
        ASSERT_TRUE(file.open(at("f").c_str(), 0x36 | (platform ? 0 : File::FILE_CRT), false));
        file->seek(0, 0);
        EXPECT_EQ(file->write("+", 1), 1u);
        file.close();
        EXPECT_EQ(textOf(at("f")), "abc+");
    }
}

TEST_F(FileStdDirDescriptors, let_a_descriptor_for_writing_read_too_and_keep_what_is_there) {
    put(at("f"), "abc");
    File file;
    ASSERT_TRUE(file.open(at("f").c_str(), 0x32 | File::FILE_CRT, false));
    char text[4] = {};
    EXPECT_EQ(file->read(text, 3), 3u);
    EXPECT_STREQ(text, "abc");
    File reader;
    ASSERT_TRUE(reader.open(at("f").c_str(), READ | File::FILE_CRT, false));
    EXPECT_EQ(reader->write("x", 1), ~std::uint64_t{0});
    EXPECT_EQ(textOf(at("f")), "abc");
}

TEST_F(FileStdDirDescriptors, Kept_file_01_give_all_ones_for_a_failure_of_a_descriptor) {
    File file;
    EXPECT_FALSE(file.open(at("missing").c_str(), READ | File::FILE_CRT, false));
    char c;
    EXPECT_EQ(file->read(&c, 1), ~std::uint64_t{0});
    EXPECT_EQ(file->write(&c, 1), ~std::uint64_t{0});
    ASSERT_FALSE(file.open(at("missing").c_str(), READ, false));
    EXPECT_EQ(file->read(&c, 1), 0u);
    EXPECT_EQ(file->write(&c, 1), 0u);
    ASSERT_FALSE(file.open(at("missing").c_str(), READ | File::FILE_CRT, true));
    EXPECT_EQ(file->read(&c, 1), 0u);
    EXPECT_EQ(file->write(&c, 1), 0u);
}

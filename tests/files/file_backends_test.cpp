// One suite over the three backends.

#include <zor_basis/files/file.h>

#include <zor_basis/files/f_stat.h>

#include "tests/files/opened_file.h"

#include <gtest/gtest.h>

#include <cstring>
#include <vector>

using namespace ZOR_Basis;

namespace {

template <class Backend>
struct FileBackends : FileOverBackend<Backend> {};
TYPED_TEST_SUITE(FileBackends, Backends);

} // namespace

TYPED_TEST(FileBackends, breathes) {
    File file;
    ASSERT_TRUE(this->open(file, "a b", WRITE));
    EXPECT_TRUE(this->write(file, "12345"));
    file.close();
    ASSERT_TRUE(this->open(file, "a b", READ));
    EXPECT_EQ(this->read(file, 10), "12345");
}

TYPED_TEST(FileBackends, keeps_every_byte) {
    std::string bytes;
    for (int i = 0; i < 1024; ++i) bytes.push_back(static_cast<char>(i * 7));
    bytes += "\r\n\n\x1A\r";
    File file;
    ASSERT_TRUE(this->open(file, "f", WRITE));
    EXPECT_TRUE(this->write(file, bytes));
    file.close();
    EXPECT_EQ(textOf(this->scratch / "f"), bytes);
    ASSERT_TRUE(this->open(file, "f", READ));
    EXPECT_EQ(this->read(file, bytes.size() + 5), bytes);
    EXPECT_EQ(this->read(file, 5), "");
}

TYPED_TEST(FileBackends, reads_and_writes_nothing_when_asked_for_nothing) {
    File file;
    ASSERT_TRUE(this->open(file, "f", WRITE));
    EXPECT_EQ(file->write("x", 0), 0u);
    file.close();
    EXPECT_EQ(textOf(this->scratch / "f"), "");
    ASSERT_TRUE(this->open(file, "f", READ));
    char c = 'x';
    EXPECT_EQ(file->read(&c, 0), 0u);
}

TYPED_TEST(FileBackends, goes_on_where_it_stopped) {
    put(this->scratch / "f", "abcdefg");
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    EXPECT_EQ(this->read(file, 3), "abc");
    EXPECT_EQ(this->read(file, 3), "def");
    EXPECT_EQ(this->read(file, 3), "g");
}

TYPED_TEST(FileBackends, Kept_file_02_gives_three_kinds_of_results_of_seeking) {
    put(this->scratch / "f", "abcdefgh");
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    EXPECT_EQ(file->seek(2, 0), TypeParam::position(8));
    EXPECT_EQ(file->seek(0, 2), TypeParam::position(2));
    EXPECT_EQ(this->read(file, 2), "cd");
    EXPECT_EQ(file->seek(1, 1), TypeParam::position(5));
    EXPECT_EQ(this->read(file, 1), "f");
    EXPECT_EQ(file->seek(1, -3), TypeParam::position(3));
    EXPECT_EQ(this->read(file, 1), "d");
    EXPECT_EQ(file->seek(2, -1), TypeParam::position(7));
    EXPECT_EQ(this->read(file, 5), "h");
    EXPECT_EQ(file->seek(0, -1), TypeParam::BAD_SEEK);
    for (int origin : {3, 4, 5}) EXPECT_EQ(file->seek(origin, 0), TypeParam::BAD_SEEK) << "there are three origins";
    EXPECT_EQ(file->seek(0, 0), 0);
    EXPECT_EQ(this->read(file, 1), "a");
}

TYPED_TEST(FileBackends, replaces_bytes_of_a_file_open_for_both) {
    put(this->scratch / "f", "abcdef");
    File file;
    ASSERT_TRUE(this->open(file, "f", UPDATE));
    EXPECT_EQ(this->read(file, 2), "ab");
    file->seek(0, 2);
    EXPECT_TRUE(this->write(file, "XY"));
    file->seek(0, 0);
    EXPECT_EQ(this->read(file, 9), "abXYef");
}

TYPED_TEST(FileBackends, begins_anew_when_truncating) {
    put(this->scratch / "f", "abcdef");
    File file;
    ASSERT_TRUE(this->open(file, "f", UPDATE | File::FILE_TRUNC));
    EXPECT_EQ(this->read(file, 9), "");
    EXPECT_TRUE(this->write(file, "12"));
    file.close();
    EXPECT_EQ(textOf(this->scratch / "f"), "12");
}

TYPED_TEST(FileBackends, shows_others_what_was_flushed) {
    File file;
    ASSERT_TRUE(this->open(file, "f", WRITE));
    EXPECT_TRUE(this->write(file, "12"));
    EXPECT_TRUE(file->flush());
    EXPECT_EQ(textOf(this->scratch / "f"), "12");
}

TYPED_TEST(FileBackends, reads_lines_where_it_can) {
    put(this->scratch / "f", "one\n\nthree is long\nlast");
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    char line[8];
    std::vector<std::string> lines;
    for (;;) {
        std::fill(line, line + sizeof line, '#');
        std::uint64_t const n = file->getline(line, sizeof line);
        if (!TypeParam::READS_LINES) {
            EXPECT_EQ(n, 0u);
            EXPECT_EQ(line[0], '#') << "untouched";
            return;
        }
        EXPECT_EQ(line[sizeof line - 1], '\0');
        if (n == 0) break;
        lines.emplace_back(line, n);
        EXPECT_EQ(std::strlen(line), n);
    }
    EXPECT_EQ(lines, (std::vector<std::string>{"one\n", "\n", "three i", "s long\n", "last"}));
    EXPECT_EQ(file->getline(line, sizeof line), 0u);
    EXPECT_EQ(file->getline(line, 0), 0u);
}

TYPED_TEST(FileBackends, measures_a_line_up_to_its_first_zero) {
    if (!TypeParam::READS_LINES) return;
    put(this->scratch / "f", std::string("ab\0cd\nnext\n", 11));
    File file;
    ASSERT_TRUE(this->open(file, "f", READ));
    char line[32];
    EXPECT_EQ(file->getline(line, sizeof line), 2u);
    EXPECT_EQ(file->getline(line, sizeof line), 5u);
}

TYPED_TEST(FileBackends, reaches_beyond_four_gigabytes) {
    put(this->scratch / "large", "x");
    std::uint64_t const size = std::uint64_t{5} << 30;
    std::filesystem::resize_file(this->scratch / "large", size);
    File file;
    ASSERT_TRUE(this->open(file, "large", UPDATE));
    EXPECT_EQ(file->seek(2, 0), TypeParam::position(static_cast<std::int64_t>(size)));
    EXPECT_TRUE(this->write(file, "end"));
    file->seek(2, -3);
    EXPECT_EQ(this->read(file, 9), "end");
    file.close();
    EXPECT_EQ(FStat::size((this->scratch / "large").c_str()), size + 3);
}

TYPED_TEST(FileBackends, takes_both_slash_kinds) {
    makeFolder(this->scratch / "a b");
    File file;
    ASSERT_TRUE(file.open((this->scratch.path() + "\\a b/f").c_str(), WRITE | TypeParam::MODE, TypeParam::FLAG));
    EXPECT_TRUE(exists(this->scratch / "a b/f"));
}

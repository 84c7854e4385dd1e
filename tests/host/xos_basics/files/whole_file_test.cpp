#include "basis/platform/xos_basics.h"
#include "tests/host/support/status.h"
#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <array>
#include <cstddef>
#include <ctime>
#include <thread>

namespace {

int copy(std::string const& dst, std::string const& src, int overwrite = 0) {
    return xos_FileCopy(dst.c_str(), src.c_str(), overwrite);
}

int move(std::string const& dst, std::string const& src, int overwrite = 0) {
    return xos_FileMove(dst.c_str(), src.c_str(), overwrite);
}

int hardLink(std::string const& src, std::string const& dst) { return xos_FileHardLink(src.c_str(), dst.c_str()); }

int removeFile(std::string const& path, std::uint32_t flags = 0) { return xos_FileRemove(path.c_str(), flags); }

using Operation = int (*)(std::string const&, std::string const&, int);

} // namespace

TEST(HostFileCopy, gives_a_second_file_with_the_same_content) {
    Scratch const scratch;
    put(scratch / "a", "content");
    EXPECT_EQ(copy(scratch / "b", scratch / "a"), 0);
    EXPECT_EQ(textOf(scratch / "b"), "content");
    EXPECT_EQ(textOf(scratch / "a"), "content");
    put(scratch / "b", "other");
    EXPECT_EQ(textOf(scratch / "a"), "content");
    EXPECT_EQ(scratch.content(), (Names{"a", "b"}));
}

TEST(HostFileCopy, copies_every_byte_of_files_of_every_size) {
    Scratch const scratch;
    for (std::size_t size : {0UL, 1UL, 511UL, 4096UL, 65'535UL, 65'536UL, 65'537UL, 200'000UL, 3'000'001UL}) {
        std::string content(size, '\0');
        for (std::size_t i = 0; i < size; ++i) { content[i] = static_cast<char>(i * 31 + i / 4099); }
        put(scratch / "a", content);
        EXPECT_EQ(copy(scratch / "b", scratch / "a", 1), 0) << size;
        EXPECT_TRUE(textOf(scratch / "b") == content) << size;
    }
}

TEST(HostFileCopy, keeps_permissions_and_modification_time) {
    Scratch const scratch;
    put(scratch / "a", "content");
    setAge(scratch / "a", std::chrono::hours{5000});
    writeProtect(scratch / "a");
    EXPECT_EQ(copy(scratch / "b", scratch / "a"), 0);
    EXPECT_EQ(statusOf(scratch / "b").st_mode_, statusOf(scratch / "a").st_mode_);
    EXPECT_EQ(statusOf(scratch / "b").st_mode_ & 0200, 0);
    EXPECT_EQ(statusOf(scratch / "b").st_mtime_, statusOf(scratch / "a").st_mtime_);
    EXPECT_EQ(copy(scratch / "c", scratch / "b"), 0);
    EXPECT_EQ(statusOf(scratch / "c").st_mtime_, statusOf(scratch / "a").st_mtime_);
    for (char const* name : {"a", "b", "c"}) { EXPECT_EQ(removeFile(scratch / name), 0) << name; }
}

TEST(HostFileCopy, leaves_an_existing_target_alone_unless_told) {
    Scratch const scratch;
    put(scratch / "a", "new");
    put(scratch / "b", "old and longer");
    clearSystemError();
    EXPECT_NE(copy(scratch / "b", scratch / "a", 0), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(textOf(scratch / "b"), "old and longer");
    EXPECT_EQ(copy(scratch / "b", scratch / "a", 1), 0);
    EXPECT_EQ(textOf(scratch / "b"), "new");
    EXPECT_EQ(scratch.content(), (Names{"a", "b"}));
}

TEST(HostFileCopy, replaces_a_write_protected_file) {
    Scratch const scratch;
    put(scratch / "a", "new");
    put(scratch / "b", "old");
    writeProtect(scratch / "b");
    EXPECT_EQ(copy(scratch / "b", scratch / "a", 1), 0);
    EXPECT_EQ(textOf(scratch / "b"), "new");
    EXPECT_EQ(scratch.content(), (Names{"a", "b"}));
}

TEST(HostFileCopy, shows_the_new_content_only_under_a_new_file) {
    Scratch const scratch;
    put(scratch / "a", "new");
    put(scratch / "b", "old");
    EXPECT_EQ(hardLink(scratch / "b", scratch / "c"), 0);
    EXPECT_EQ(copy(scratch / "b", scratch / "a", 1), 0);
    EXPECT_EQ(textOf(scratch / "b"), "new");
    EXPECT_EQ(textOf(scratch / "c"), "old");
}

TEST(HostFileCopy, refuses_to_copy_a_file_onto_itself) {
    Scratch const scratch;
    put(scratch / "a", "content");
    EXPECT_EQ(hardLink(scratch / "a", scratch / "b"), 0);
    EXPECT_NE(copy(scratch / "a", scratch / "a", 1), 0);
    EXPECT_NE(copy(scratch / "b", scratch / "a", 1), 0);
    EXPECT_EQ(textOf(scratch / "a"), "content");
    EXPECT_EQ(textOf(scratch / "b"), "content");
    EXPECT_EQ(scratch.content(), (Names{"a", "b"}));
}

TEST(HostFileCopy, gives_one_winner_of_many_that_may_not_overwrite) {
    Scratch const scratch;
    std::string const one(150'000, '1');
    std::string const two(150'000, '2');
    put(scratch / "one", one);
    put(scratch / "two", two);
    for (int round = 0; round < 30; ++round) {
        int results[2] = {};
        std::thread other{[&] { results[1] = copy(scratch / "target", scratch / "two"); }};
        results[0] = copy(scratch / "target", scratch / "one");
        other.join();
        EXPECT_EQ((results[0] == 0) + (results[1] == 0), 1);
        EXPECT_EQ(textOf(scratch / "target"), results[0] == 0 ? one : two);
        EXPECT_EQ(scratch.content(), (Names{"one", "two", "target"}));
        EXPECT_EQ(removeFile(scratch / "target"), 0);
    }
}

TEST(HostFileMove, gives_the_file_its_new_name) {
    Scratch const scratch;
    put(scratch / "a", "content");
    makeFolder(scratch / "in");
    setAge(scratch / "a", std::chrono::hours{5000});
    std::int64_t const time = statusOf(scratch / "a").st_mtime_;
    EXPECT_EQ(move(scratch / "in/b", scratch / "a"), 0);
    EXPECT_EQ(scratch.content(), (Names{"in/", "in/b"}));
    EXPECT_EQ(textOf(scratch / "in/b"), "content");
    EXPECT_EQ(statusOf(scratch / "in/b").st_mtime_, time);
}

TEST(HostFileMove, leaves_an_existing_target_alone_unless_told) {
    Scratch const scratch;
    put(scratch / "a", "new");
    put(scratch / "b", "old");
    clearSystemError();
    EXPECT_NE(move(scratch / "b", scratch / "a", 0), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(textOf(scratch / "a"), "new");
    EXPECT_EQ(textOf(scratch / "b"), "old");
    EXPECT_EQ(move(scratch / "b", scratch / "a", 1), 0);
    EXPECT_EQ(textOf(scratch / "b"), "new");
    EXPECT_EQ(scratch.content(), Names{"b"});
}

TEST(HostFileMove, moves_and_replaces_write_protected_files) {
    Scratch const scratch;
    put(scratch / "a", "new");
    put(scratch / "b", "old");
    writeProtect(scratch / "a");
    writeProtect(scratch / "b");
    EXPECT_EQ(move(scratch / "b", scratch / "a", 1), 0);
    EXPECT_EQ(textOf(scratch / "b"), "new");
    EXPECT_EQ(statusOf(scratch / "b").st_mode_ & 0200, 0);
    EXPECT_EQ(move(scratch / "c", scratch / "b"), 0);
    EXPECT_EQ(scratch.content(), Names{"c"});
    EXPECT_EQ(removeFile(scratch / "c"), 0);
}

TEST(HostFileMove, onto_itself_succeeds_where_it_may_overwrite_and_loses_nothing_where_not) {
    Scratch const scratch;
    put(scratch / "a", "content");
    EXPECT_EQ(move(scratch / "a", scratch / "a", 1), 0);
    EXPECT_NE(move(scratch / "a", scratch / "a", 0), 0);
    EXPECT_EQ(textOf(scratch / "a"), "content");
}

TEST(HostFileMove, gives_one_winner_of_many_that_may_not_overwrite) {
    Scratch const scratch;
    for (int round = 0; round < 100; ++round) {
        put(scratch / "one", "1");
        put(scratch / "two", "2");
        int results[2] = {};
        std::thread other{[&] { results[1] = move(scratch / "target", scratch / "two"); }};
        results[0] = move(scratch / "target", scratch / "one");
        other.join();
        EXPECT_EQ((results[0] == 0) + (results[1] == 0), 1);
        EXPECT_EQ(scratch.content(), (Names{"target", results[0] == 0 ? "two" : "one"}));
        EXPECT_EQ(removeFile(scratch / "target"), 0);
    }
}

TEST(HostFileCopyAndMove, fail_and_leave_everything_as_it_was) {
    struct Case {
        Row row;
        char const* dst;
        char const* src;
        int overwrite;
    };
    for (Case const& c : {
             Case{{}, "new", "missing", 0},
             Case{{}, "new", "missing", 1},
             Case{{}, "file", "missing", 1},
             Case{{}, "new", "no/such/file", 1},
             Case{{}, "no/such", "file", 0},
             Case{{}, "no/such", "file", 1},
             Case{{}, "file/below", "other", 1},
             // a directory is neither replaced, nor copied or moved as a file
             Case{{}, "empty", "file", 0},
             Case{{}, "empty", "file", 1},
             Case{{}, "full", "file", 1},
             Case{{}, "new", "full", 0},
             Case{{}, "new", "full", 1},
             Case{{}, "new", "empty", 1},
             Case{{}, "file", "full", 1},
             Case{{}, "new", "", 0},
             Case{{}, "", "file", 0},
             Case{{}, "", "file", 1},
             Case{{}, "empty/", "file", 1},
             Case{{}, "new/", "file", 0},
         }) {
        SCOPED_TRACE(c.row);
        for (Operation operation : {Operation{copy}, Operation{move}}) {
            SCOPED_TRACE(operation == Operation{copy} ? "copy" : "move");
            Scratch const scratch;
            put(scratch / "file", "file");
            put(scratch / "other", "other");
            makeFolder(scratch / "empty");
            makeFolder(scratch / "full");
            put(scratch / "full/f", "f");
            Names const before = scratch.content();
            std::string const dst = *c.dst == '\0' ? "" : scratch / c.dst;
            std::string const src = *c.src == '\0' ? "" : scratch / c.src;
            clearSystemError();
            EXPECT_NE(operation(dst, src, c.overwrite), 0);
            EXPECT_NE(systemError(), 0);
            EXPECT_EQ(scratch.content(), before);
            EXPECT_EQ(textOf(scratch / "file"), "file");
            EXPECT_EQ(textOf(scratch / "other"), "other");
        }
    }
}

TEST(HostFileCopyAndMove, refuse_no_path) {
    Scratch const scratch;
    put(scratch / "a", "a");
    std::string const path = scratch / "a";
    clearSystemError();
    EXPECT_NE(xos_FileCopy(nullptr, path.c_str(), 1), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_NE(xos_FileCopy(path.c_str(), nullptr, 1), 0);
    EXPECT_NE(xos_FileMove(nullptr, path.c_str(), 1), 0);
    EXPECT_NE(xos_FileMove(path.c_str(), nullptr, 1), 0);
    EXPECT_NE(xos_FileHardLink(nullptr, path.c_str()), 0);
    EXPECT_NE(xos_FileHardLink(path.c_str(), nullptr), 0);
    EXPECT_NE(xos_FileRemove(nullptr, 0), 0);
    xos_Stat record{};
    EXPECT_NE(xos_FileStatByNameEx(nullptr, &record, 0), 0);
    EXPECT_NE(xos_FileStatByNameEx(path.c_str(), nullptr, 0), 0);
    EXPECT_EQ(scratch.content(), Names{"a"});
}

TEST(HostFileHardLink, gives_one_file_two_names) {
    Scratch const scratch;
    put(scratch / "a", "one");
    EXPECT_EQ(hardLink(scratch / "a", scratch / "b"), 0);
    put(scratch / "b", "two");
    EXPECT_EQ(textOf(scratch / "a"), "two");
    EXPECT_EQ(statusOf(scratch / "a").st_nlink_, 2);
    EXPECT_EQ(removeFile(scratch / "a"), 0);
    EXPECT_EQ(textOf(scratch / "b"), "two");
    EXPECT_EQ(statusOf(scratch / "b").st_nlink_, 1);
}

TEST(HostFileHardLink, fails_for_what_is_missing_what_is_taken_and_directories) {
    Scratch const scratch;
    put(scratch / "a", "a");
    put(scratch / "b", "b");
    makeFolder(scratch / "d");
    clearSystemError();
    EXPECT_NE(hardLink(scratch / "missing", scratch / "c"), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_NE(hardLink(scratch / "a", scratch / "b"), 0);
    EXPECT_NE(hardLink(scratch / "a", scratch / "d"), 0);
    EXPECT_NE(hardLink(scratch / "d", scratch / "c"), 0);
    EXPECT_NE(hardLink(scratch / "a", scratch / "no/such"), 0);
    EXPECT_EQ(scratch.content(), (Names{"a", "b", "d/"}));
    EXPECT_EQ(textOf(scratch / "b"), "b");
}

TEST(HostFileRemove, removes_files_whatever_its_flags_and_their_protection) {
    Scratch const scratch;
    for (std::uint32_t flags : {0U, 0x400U, 0x800U, 0xC00U, 0x200U}) {
        put(scratch / "a", "a");
        if (flags == 0x400) writeProtect(scratch / "a");
        EXPECT_EQ(removeFile(scratch / "a", flags), 0) << flags;
        EXPECT_EQ(scratch.content(), Names{});
    }
}

TEST(HostFileRemove, fails_for_what_is_missing_and_for_directories) {
    Scratch const scratch;
    makeFolder(scratch / "d");
    for (char const* name : {"missing", "no/such", "d", "d/"}) {
        clearSystemError();
        EXPECT_NE(removeFile(scratch / name, 0x400), 0) << name;
        EXPECT_NE(systemError(), 0) << name;
    }
    EXPECT_NE(removeFile(""), 0);
    EXPECT_EQ(scratch.content(), Names{"d/"});
}

TEST(HostFileStatus, has_the_record_of_56_bytes) {
    static_assert(sizeof(xos_Stat) == 56);
    static_assert(offsetof(xos_Stat, st_mode_) == 6);
    static_assert(offsetof(xos_Stat, st_size_) == 24);
    static_assert(offsetof(xos_Stat, st_atime_) == 32);
    static_assert(offsetof(xos_Stat, st_mtime_) == 40);
    static_assert(offsetof(xos_Stat, st_ctime_) == 48);
}

TEST(HostFileStatus, tells_kind_size_and_times) {
    Scratch const scratch;
    std::int64_t const now = std::time(nullptr);
    put(scratch / "f", "12345");
    makeFolder(scratch / "d");
    xos_Stat const file = statusOf(scratch / "f");
    EXPECT_EQ(file.st_mode_ & KIND_MASK, KIND_FILE);
    EXPECT_EQ(file.st_mode_ & 0600, 0600);
    EXPECT_EQ(file.st_size_, 5);
    EXPECT_EQ(file.st_nlink_, 1);
    for (std::int64_t time : {file.st_mtime_, file.st_atime_, file.st_ctime_}) { EXPECT_NEAR(time, now, 5); }
    EXPECT_EQ(kindOf(scratch / "d"), KIND_DIRECTORY);
    EXPECT_EQ(kindOf(scratch / "d/"), KIND_DIRECTORY);
    setAge(scratch / "f", std::chrono::hours{100'000});
    EXPECT_NEAR(statusOf(scratch / "f").st_mtime_, now - 360'000'000, 5);
}

TEST(HostFileStatus, tells_a_protected_file) {
    Scratch const scratch;
    put(scratch / "f", "");
    writeProtect(scratch / "f");
    EXPECT_EQ(statusOf(scratch / "f").st_mode_ & 0222, 0);
    EXPECT_EQ(removeFile(scratch / "f"), 0);
}

TEST(HostFileStatus, fails_for_what_is_missing_and_leaves_the_record) {
    Scratch const scratch;
    xos_Stat record{};
    record.st_size_ = 77;
    for (std::string const& path : {scratch / "missing", scratch / "no/such", std::string{}}) {
        clearSystemError();
        EXPECT_NE(xos_FileStatByNameEx(path.c_str(), &record, 0x4000), 0) << path;
        EXPECT_NE(systemError(), 0) << path;
    }
    EXPECT_EQ(record.st_size_, 77);
}

TEST(HostFileNames, may_be_long_and_strange) {
    std::string const longName(250, 'n');
    for (std::string const& name : {std::string{"a b  c"}, std::string{" leading"}, std::string{"semi;colon&$(x)'`%d"},
                                    std::string{"-rf"}, std::string{".hidden"}, longName}) {
        SCOPED_TRACE(name);
        Scratch const scratch;
        put(scratch / "source", name);
        EXPECT_EQ(copy(scratch / name, scratch / "source"), 0);
        EXPECT_EQ(scratch.content(), (Names{"source", name}));
        EXPECT_EQ(copy(scratch / name, scratch / "source", 1), 0);
        EXPECT_EQ(move(scratch / "back", scratch / name), 0);
        EXPECT_EQ(hardLink(scratch / "back", scratch / name), 0);
        EXPECT_EQ(statusOf(scratch / name).st_size_, static_cast<std::int64_t>(name.size()));
        EXPECT_EQ(removeFile(scratch / name), 0);
        EXPECT_EQ(scratch.content(), (Names{"source", "back"}));
    }
}

TEST(HostFileNames, work_in_paths_of_more_than_a_thousand_characters) {
    Scratch const scratch;
    std::string path = scratch.path();
    for (int level = 0; level < 12; ++level) {
        path += "/" + std::string(99, static_cast<char>('a' + level));
        ASSERT_EQ(xos_DirCreateEx(path.c_str(), 0), 0);
    }
    xos_File const file = xos_FileOpen((path + "/f").c_str(), 0x14);
    ASSERT_NE(file, 0U);
    EXPECT_EQ(xos_FileWriteEx(file, "far", 3, 0, 0), 3U);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
    EXPECT_EQ(copy(path + "/g", path + "/f"), 0);
    EXPECT_EQ(hardLink(path + "/g", path + "/h"), 0);
    EXPECT_EQ(move(path + "/i", path + "/g"), 0);
    EXPECT_EQ(statusOf(path + "/i").st_size_, 3);
    EXPECT_EQ(kindOf(path), KIND_DIRECTORY);
    EXPECT_EQ(removeFile(path + "/f"), 0);
    EXPECT_EQ(copy(scratch / "i", path + "/i"), 0);
    EXPECT_EQ(textOf(scratch / "i"), "far");
    xos_Dir const listing = xos_DirOpenEx(path.c_str(), "h", 0);
    EXPECT_STREQ(xos_DirNextEx(listing, 0, 0, 0), "h");
    xos_DirClose(listing);
    EXPECT_EQ(xos_DirRemove((scratch / std::string(99, 'a')).c_str(), 0x600), 0);
    EXPECT_EQ(scratch.content(), Names{"i"});
}

#include <zor_basis/files/file_entry.h>

#include "tests/support/scratch.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileEntryOnDisk : testing::Test {
    Str here() const { return Str(scratch.path()); }
    Scratch scratch;
};

} // namespace

TEST_F(FileEntryOnDisk, breathes) {
    put(scratch / "a b", "123");
    FileEntry const entry(here(), "a b", 77);
    EXPECT_TRUE(entry.exist());
    EXPECT_TRUE(entry.isFile());
    EXPECT_FALSE(entry.isDir());
    EXPECT_EQ(entry.getType(), FStat::ST_FILE);
    EXPECT_EQ(entry.getSize(), 3u);
    EXPECT_EQ(entry.getTime(), 77);
    EXPECT_STREQ(entry.getDir().c_str(), scratch.path().c_str());
    EXPECT_STREQ(entry.getName().c_str(), "a b");
    EXPECT_STREQ(entry.getFullPath().c_str(), (scratch / "a b").c_str());
}

TEST_F(FileEntryOnDisk, stores_what_it_is_given_without_a_look) {
    FileEntry const entry(FStat::ST_LINK, "no/such\\", "name", std::uint64_t{1} << 40, -5);
    EXPECT_EQ(entry.getType(), FStat::ST_LINK);
    EXPECT_TRUE(entry.exist());
    EXPECT_FALSE(entry.isFile());
    EXPECT_FALSE(entry.isDir());
    EXPECT_EQ(entry.getSize(), std::uint64_t{1} << 40);
    EXPECT_EQ(entry.getTime(), -5);
    EXPECT_STREQ(entry.getDir().c_str(), "no/such\\");
    EXPECT_STREQ(entry.getName().c_str(), "name");
    EXPECT_STREQ(entry.getFullPath().c_str(), "no/such\\/name");
    EXPECT_FALSE(FileEntry(FStat::ST_NONE, "", "x", 0, 0).exist());
    EXPECT_STREQ(FileEntry(FStat::ST_FILE, "", "x", 0, 0).getFullPath().c_str(), "x");
    EXPECT_STREQ(FileEntry(FStat::ST_FILE, "d", nullptr, 0, 0).getFullPath().c_str(), "d");
}

TEST_F(FileEntryOnDisk, takes_names_as_either_text) {
    makeFolder(scratch / "d");
    FileEntry const entry(here(), Str("d"), 3);
    EXPECT_TRUE(entry.isDir());
    EXPECT_EQ(entry.getSize(), 0u);
    EXPECT_EQ(entry.getTime(), 3);
    EXPECT_STREQ(entry.getFullPath().c_str(), (scratch / "d").c_str());
}

TEST_F(FileEntryOnDisk, has_no_time_where_nothing_is) {
    FileEntry const entry(here(), "missing", 99);
    EXPECT_FALSE(entry.exist());
    EXPECT_EQ(entry.getTime(), 0);
    EXPECT_EQ(entry.getSize(), 0u);
    EXPECT_STREQ(entry.getFullPath().c_str(), (scratch / "missing").c_str());
}

TEST_F(FileEntryOnDisk, splits_a_full_path) {
    put(scratch / "f", "12");
    std::string const path = scratch / "f";
    FileEntry const entry{Str(path)};
    EXPECT_STREQ(entry.getDir().c_str(), scratch.path().c_str());
    EXPECT_STREQ(entry.getName().c_str(), "f");
    EXPECT_STREQ(entry.getFullPath().c_str(), path.c_str());
    EXPECT_EQ(entry.getSize(), 2u);
    EXPECT_EQ(entry.getTime(), 0);
    FileEntry const bare(Str("zb-missing"));
    EXPECT_TRUE(bare.getDir().empty());
    EXPECT_STREQ(bare.getName().c_str(), "zb-missing");
    FileEntry const top(Str("/zb-missing"));
    EXPECT_STREQ(top.getDir().c_str(), "/zb-missing") << "as every path is split there";
    EXPECT_STREQ(top.getName().c_str(), "zb-missing");
}

TEST_F(FileEntryOnDisk, refreshes_what_has_changed) {
    put(scratch / "f", "12");
    FileEntry entry(here(), "f", 50);
    EXPECT_FALSE(entry.Refresh()) << "nothing changed";
    put(scratch / "f", "123");
    EXPECT_TRUE(entry.Refresh()) << "grown";
    EXPECT_EQ(entry.getSize(), 3u);
    EXPECT_EQ(entry.getTime(), 50);
    put(scratch / "f", "321");
    EXPECT_FALSE(entry.Refresh()) << "of the same size";
    std::filesystem::remove(scratch / "f");
    EXPECT_TRUE(entry.Refresh()) << "gone";
    EXPECT_FALSE(entry.exist());
    EXPECT_EQ(entry.getSize(), 0u);
    EXPECT_EQ(entry.getTime(), 0);
    EXPECT_FALSE(entry.Refresh()) << "still gone";
    makeFolder(scratch / "f");
    EXPECT_TRUE(entry.Refresh()) << "a directory now";
    EXPECT_TRUE(entry.isDir());
    EXPECT_EQ(entry.getSize(), 0u);
    EXPECT_FALSE(entry.Refresh());
    std::filesystem::remove(scratch / "f");
    put(scratch / "f", "");
    EXPECT_TRUE(entry.Refresh()) << "an empty file now";
    EXPECT_FALSE(entry.Refresh());
}

TEST_F(FileEntryOnDisk, Kept_entry_01_keeps_the_time_of_a_changed_file) {
    put(scratch / "f", "12");
    FileEntry entry(here(), "f", 50);
    put(scratch / "f", "1234");
    EXPECT_TRUE(entry.Refresh());
    EXPECT_EQ(entry.getTime(), 50);
    std::filesystem::remove(scratch / "f");
    makeFolder(scratch / "f");
    EXPECT_TRUE(entry.Refresh());
    EXPECT_EQ(entry.getTime(), 50) << "of a directory, too";
    EXPECT_EQ(entry.getSize(), 0u);
}

TEST_F(FileEntryOnDisk, forgets_a_size_that_was_given_to_a_directory_without_a_change) {
    makeFolder(scratch / "d");
    FileEntry entry(FStat::ST_DIR, here(), "d", 4096, 1);
    EXPECT_FALSE(entry.Refresh());
    EXPECT_EQ(entry.getSize(), 0u);
}

TEST_F(FileEntryOnDisk, joins_its_full_path_again) {
    FileEntry entry(FStat::ST_FILE, "dir", "name", 1, 2);
    entry.updateFullPath();
    EXPECT_STREQ(entry.getFullPath().c_str(), "dir/name");
}

TEST_F(FileEntryOnDisk, is_copied_and_moved_with_all_its_fields) {
    FileEntry const entry(FStat::ST_OTHER, "dir", std::string(300, 'n').c_str(), 1, 2);
    FileEntry const copy(entry);
    FileEntry source(entry);
    FileEntry const moved(std::move(source));
    FileEntry assigned(FStat::ST_FILE, "x", "y", 5, 6);
    assigned = entry;
    for (FileEntry const* each : {&copy, &moved, static_cast<FileEntry const*>(&assigned)}) {
        EXPECT_EQ(each->getType(), FStat::ST_OTHER);
        EXPECT_STREQ(each->getDir().c_str(), "dir");
        EXPECT_EQ(each->getName().size(), 300u);
        EXPECT_EQ(each->getFullPath().size(), 304u);
        EXPECT_EQ(each->getSize(), 1u);
        EXPECT_EQ(each->getTime(), 2);
    }
}

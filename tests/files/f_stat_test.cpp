#include <zor_basis/files/f_stat.h>

#include "tests/support/scratch.h"

#include <zor_basis/text/wb_str.h>

#include <gtest/gtest.h>

#include <chrono>
#include <type_traits>

using namespace ZOR_Basis;

namespace {

struct FStatOnDisk : testing::Test {
    static std::int64_t now() {
        return std::chrono::duration_cast<std::chrono::seconds>(std::chrono::system_clock::now().time_since_epoch())
            .count();
    }
    static std::basic_string<WChar> wide(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }

    static void expectCleared(FStat const& entry) {
        EXPECT_EQ(entry.type(), FStat::ST_NONE);
        EXPECT_FALSE(entry.exist());
        EXPECT_FALSE(entry.isFile());
        EXPECT_FALSE(entry.isDir());
        EXPECT_EQ(entry.size(), 0u);
        EXPECT_EQ(entry.modified(), 0);
        EXPECT_EQ(entry.created(), 0);
        EXPECT_EQ(entry.accessed(), 0);
    }

    Scratch scratch;
};

} // namespace

TEST_F(FStatOnDisk, breathes) {
    put(scratch / "a b.txt", "12345");
    FStat const entry((scratch / "a b.txt").c_str());
    EXPECT_TRUE(entry.exist());
    EXPECT_EQ(entry.size(), 5u);
}

TEST_F(FStatOnDisk, is_cleared_before_it_is_examined) { expectCleared(FStat()); }

TEST_F(FStatOnDisk, tells_kind_size_and_times_of_a_file) {
    std::int64_t const before = now() - 2;
    put(scratch / "file", "123");
    FStat entry;
    ASSERT_TRUE(entry.update((scratch / "file").c_str()));
    EXPECT_EQ(entry.type(), FStat::ST_FILE);
    EXPECT_TRUE(entry.isFile());
    EXPECT_FALSE(entry.isDir());
    EXPECT_EQ(entry.size(), 3u);
    for (std::int64_t time : {entry.modified(), entry.created(), entry.accessed()}) {
        EXPECT_GE(time, before);
        EXPECT_LE(time, now() + 2);
    }
}

TEST_F(FStatOnDisk, takes_the_modification_time_from_its_own_field) {
    put(scratch / "old", "1");
    namespace fs = std::filesystem;
    fs::last_write_time(scratch / "old", fs::file_time_type::clock::now() - std::chrono::hours(24 * 400));
    FStat const entry((scratch / "old").c_str());
    EXPECT_NEAR(static_cast<double>(now() - entry.modified()), 400.0 * 86400, 4000);
}

TEST_F(FStatOnDisk, tells_a_directory) {
    makeFolder(scratch / "folder");
    FStat const entry((scratch / "folder").c_str());
    EXPECT_EQ(entry.type(), FStat::ST_DIR);
    EXPECT_TRUE(entry.exist());
    EXPECT_TRUE(entry.isDir());
    EXPECT_FALSE(entry.isFile());
}

TEST_F(FStatOnDisk, finds_nothing_at_missing_null_and_empty_paths) {
    std::string const missing = scratch / "no/such";
    for (char const* path : {missing.c_str(), "", static_cast<char const*>(nullptr)}) {
        for (bool fallback : {true, false}) {
            FStat entry((scratch / ".").c_str());
            ASSERT_TRUE(entry.exist());
            EXPECT_FALSE(entry.update(path, fallback));
            expectCleared(entry);
            expectCleared(FStat(path, fallback));
        }
    }
}

TEST_F(FStatOnDisk, takes_both_slash_kinds) {
    makeFolder(scratch / "a/b");
    put(scratch / "a/b/c", "1234");
    EXPECT_EQ(FStat::size((scratch.path() + "\\a\\b/c").c_str()), 4u);
}

TEST_F(FStatOnDisk, has_static_forms_of_every_query) {
    put(scratch / "f", "12");
    std::string const file = scratch / "f";
    std::string const missing = scratch / "g";
    FStat const entry(file.c_str());
    EXPECT_EQ(FStat::type(file.c_str()), FStat::ST_FILE);
    EXPECT_TRUE(FStat::exist(file.c_str()));
    EXPECT_TRUE(FStat::isFile(file.c_str()));
    EXPECT_FALSE(FStat::isDir(file.c_str()));
    EXPECT_TRUE(FStat::isDir(scratch.path().c_str()));
    EXPECT_EQ(FStat::size(file.c_str()), 2u);
    EXPECT_EQ(FStat::modified(file.c_str()), entry.modified());
    EXPECT_EQ(FStat::created(file.c_str()), entry.created());
    EXPECT_EQ(FStat::accessed(file.c_str()), entry.accessed());
    EXPECT_EQ(FStat::type(missing.c_str()), FStat::ST_NONE);
    EXPECT_FALSE(FStat::exist(missing.c_str()));
    EXPECT_FALSE(FStat::isFile(missing.c_str()));
    EXPECT_FALSE(FStat::isDir(missing.c_str()));
    EXPECT_EQ(FStat::size(missing.c_str()), 0u);
    EXPECT_EQ(FStat::modified(missing.c_str()), 0);
    EXPECT_EQ(FStat::created(missing.c_str()), 0);
    EXPECT_EQ(FStat::accessed(missing.c_str()), 0);
}

TEST_F(FStatOnDisk, reads_wide_paths) {
    put(scratch / "f", "12");
    FStat entry;
    EXPECT_TRUE(entry.updateW(wide(scratch / "f").c_str()));
    EXPECT_EQ(entry.type(), FStat::ST_FILE);
    EXPECT_EQ(entry.size(), 2u);
    EXPECT_EQ(entry.modified(), FStat::modified((scratch / "f").c_str()));
    EXPECT_EQ(FStat(wide(scratch.path()).c_str()).type(), FStat::ST_DIR);
    EXPECT_FALSE(entry.updateW(wide(scratch / "g").c_str()));
    expectCleared(entry);
    EXPECT_FALSE(entry.updateW(nullptr));
}

TEST_F(FStatOnDisk, sees_sizes_above_four_gigabytes) {
    put(scratch / "large", "x");
    std::uint64_t const size = (std::uint64_t{5} << 30) + 3;
    std::filesystem::resize_file(scratch / "large", size);
    EXPECT_EQ(FStat::size((scratch / "large").c_str()), size);
    EXPECT_EQ(FStat(wide(scratch / "large").c_str()).size(), size);
}

TEST_F(FStatOnDisk, does_not_retry_what_is_simply_missing) {
    auto const start = std::chrono::steady_clock::now();
    FStat entry;
    EXPECT_FALSE(entry.updateMultiRetryNetwork((scratch / "g").c_str()));
    EXPECT_FALSE(entry.updateMultiRetryNetwork((scratch / "g").c_str(), false));
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(900));
    put(scratch / "g", "1");
    EXPECT_TRUE(entry.updateMultiRetryNetwork((scratch / "g").c_str()));
    EXPECT_EQ(entry.size(), 1u);
}

TEST_F(FStatOnDisk, is_a_plain_value) {
    static_assert(std::is_trivially_copyable_v<FStat>);
    put(scratch / "f", "12");
    FStat const entry((scratch / "f").c_str());
    FStat copy(entry);
    EXPECT_EQ(copy.size(), 2u);
    copy = FStat();
    expectCleared(copy);
    copy = entry;
    EXPECT_EQ(copy.type(), FStat::ST_FILE);
}

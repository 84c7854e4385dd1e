#include <zor_basis/files/dir_iterator.h>

#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <chrono>
#include <memory>

using namespace ZOR_Basis;

namespace {

using WideText = std::basic_string<WChar>;

WideText wide(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }
std::string plain(WChar const* name) {
    std::string text;
    for (; *name != 0; ++name) text.push_back(static_cast<char>(*name));
    return text;
}

struct DirIteratorInAFolder : testing::Test {
    WideText here() const { return wide(scratch.path()); }

    static Names namesOf(DirIterImplW& list) {
        Names names;
        while (WChar const* name = list.next()) EXPECT_TRUE(names.insert(plain(name)).second) << plain(name);
        return names;
    }

    Scratch scratch;
};

} // namespace

TEST_F(DirIteratorInAFolder, breathes) {
    put(scratch / "page 1.tif", "123");
    DirIteratorW list(LOOK_ALL, here().c_str());
    WChar const* const name = list->next();
    ASSERT_NE(name, nullptr);
    EXPECT_EQ(plain(name), "page 1.tif");
    EXPECT_TRUE(list->isFile());
    EXPECT_FALSE(list->isDir());
    EXPECT_EQ(list->size(), 3u);
    EXPECT_EQ(list->next(), nullptr);
    EXPECT_EQ(list->lastError(), 18u);
}

TEST_F(DirIteratorInAFolder, answers_without_an_entry_and_without_a_fault) {
    put(scratch / "file", "123");
    DirIteratorW list(LOOK_ALL, here().c_str());
    EXPECT_TRUE(list->isFile());
    EXPECT_FALSE(list->isDir());
    EXPECT_EQ(list->size(), 0u);
    EXPECT_LE(list->time(), 0);
    while (list->next() != nullptr) {}
    EXPECT_NE(list->isFile(), list->isDir());
    list->finish();
    EXPECT_NE(list->isFile(), list->isDir());
    EXPECT_LE(list->size(), 3u);
}

TEST_F(DirIteratorInAFolder, reports_the_kinds_asked_for) {
    makeFolder(scratch / "folder");
    makeFolder(scratch / "other");
    put(scratch / "file", "1");
    put(scratch / ".hidden", "1");
    struct Case {
        Row row;
        LookForType type;
        Names names;
    };
    Names const all{"folder", "other", "file", ".hidden"};
    Names const files{"file", ".hidden"};
    Names const folders{"folder", "other"};
    for (Case const& c : {
             Case{{}, LOOK_ALL, all},
             Case{{}, LOOK_FILES, files},
             Case{{}, LOOK_DIRS, folders},
             Case{{}, LOOK_BOTH, all},
             Case{{}, LOOK_ANYCASE, all},
             Case{{}, LOOK_FILES | LOOK_ANYCASE, files},
             Case{{}, LOOK_DIRS | LOOK_ANYCASE, folders},
             Case{{}, LOOK_FILES | LOOK_DIRS, all},
         }) {
        SCOPED_TRACE(c.row);
        DirIteratorW list(c.type, here().c_str());
        EXPECT_EQ(namesOf(*list.operator->()), c.names);
        EXPECT_EQ(list->lastError(), 18u);
        DirIteratorW later(LOOK_ALL, here().c_str());
        later->setType(c.type);
        EXPECT_EQ(namesOf(*later.operator->()), c.names);
    }
}

TEST_F(DirIteratorInAFolder, tells_what_each_entry_is) {
    makeFolder(scratch / "folder");
    put(scratch / "folder/inside", "not listed");
    put(scratch / "file", "1234");
    namespace fs = std::filesystem;
    fs::last_write_time(scratch / "file", fs::file_time_type::clock::now() - std::chrono::hours(24 * 400));
    auto const now =
        std::chrono::duration_cast<std::chrono::seconds>(std::chrono::system_clock::now().time_since_epoch());
    DirIteratorW list(LOOK_ALL, here().c_str());
    int seen = 0;
    while (WChar const* name = list->next()) {
        ++seen;
        bool const folder = plain(name) == "folder";
        EXPECT_EQ(list->isDir(), folder);
        EXPECT_EQ(list->isFile(), !folder);
        EXPECT_EQ(list->size(), folder ? 0u : 4u);
        EXPECT_NEAR(static_cast<double>(now.count() - list->time()), folder ? 0 : 400.0 * 86400, 4000);
    }
    EXPECT_EQ(seen, 2);
}

TEST_F(DirIteratorInAFolder, ends_at_once_in_an_empty_directory) {
    for (LookForType type : {LOOK_ALL, LOOK_FILES, LOOK_DIRS}) {
        DirIteratorW list(type, here().c_str());
        EXPECT_EQ(list->lastError(), 0u);
        EXPECT_EQ(list->next(), nullptr);
        EXPECT_EQ(list->lastError(), 18u);
        EXPECT_EQ(list->next(), nullptr) << "and stays at the end";
        EXPECT_EQ(list->lastError(), 18u);
    }
}

TEST_F(DirIteratorInAFolder, says_why_there_is_no_listing) {
    WideText const missing = here() + wide("/missing");
    DirIteratorW list(LOOK_ALL, missing.c_str());
    EXPECT_EQ(list->next(), nullptr);
    EXPECT_EQ(list->lastError(), 3u);
    EXPECT_EQ(list->next(), nullptr);
    EXPECT_EQ(list->lastError(), 3u);
    list->finish();
    EXPECT_EQ(list->lastError(), 0u);

    put(scratch / "a.txt", "");
    DirIteratorW none(LOOK_ALL, here().c_str());
    none->setWildCard(ZB_W("*.tif"));
    EXPECT_EQ(none->next(), nullptr);
    EXPECT_EQ(none->lastError(), 2u);
}

TEST_F(DirIteratorInAFolder, matches_its_wildcard) {
    for (char const* name : {"a.txt", "b.txt", "ab.tif", "c"}) put(scratch / name, "");
    makeFolder(scratch / "d.txt");
    struct Case {
        Row row;
        std::string wildcard;
        LookForType type;
        Names names;
    };
    for (Case const& c : {
             Case{{}, "", LOOK_ALL, {"a.txt", "b.txt", "ab.tif", "c", "d.txt"}},
             Case{{}, "*", LOOK_ALL, {"a.txt", "b.txt", "ab.tif", "c", "d.txt"}},
             Case{{}, "*.txt", LOOK_ALL, {"a.txt", "b.txt", "d.txt"}},
             Case{{}, "*.txt", LOOK_FILES, {"a.txt", "b.txt"}},
             Case{{}, "*.txt", LOOK_DIRS, {"d.txt"}},
             Case{{}, "?.txt", LOOK_FILES, {"a.txt", "b.txt"}},
             Case{{}, "a*", LOOK_ALL, {"a.txt", "ab.tif"}},
             Case{{}, "c", LOOK_ALL, {"c"}},
         }) {
        SCOPED_TRACE(c.row);
        std::unique_ptr<DirIterImplW> list(DirIterImplW::Make(c.type, here().c_str()));
        ASSERT_NE(list, nullptr);
        list->setWildCard(c.wildcard.c_str());
        EXPECT_EQ(namesOf(*list), c.names);
        list->finish();
        list->setWildCard(wide(c.wildcard).c_str());
        EXPECT_EQ(namesOf(*list), c.names);
        list->finish();
        WideText const wildcard = wide(c.wildcard);
        list->setWildCard(WStr(wildcard));
        EXPECT_EQ(namesOf(*list), c.names);
    }
}

TEST_F(DirIteratorInAFolder, Kept_list_dir_01_shows_the_wildcard_in_its_path_while_it_lists) {
    put(scratch / "a", "");
    DirIteratorW list(LOOK_ALL, here().c_str());
    EXPECT_EQ(plain(list->getPath().wstr()), scratch.path());
    ASSERT_NE(list->next(), nullptr);
    EXPECT_EQ(plain(list->getPath().wstr()), scratch.path() + "/*");
    EXPECT_EQ(list->next(), nullptr);
    EXPECT_EQ(plain(list->getPath().wstr()), scratch.path() + "/*");
    list->finish();
    EXPECT_EQ(plain(list->getPath().wstr()), scratch.path());
    list->setWildCard(ZB_W("a?"));
    EXPECT_EQ(list->next(), nullptr);
    EXPECT_EQ(plain(list->getPath().wstr()), scratch.path() + "/a?");
}

TEST_F(DirIteratorInAFolder, starts_again_after_it_was_finished) {
    for (char const* name : {"a", "b", "c"}) put(scratch / name, "");
    DirIteratorW list(LOOK_ALL, here().c_str());
    list->finish();
    EXPECT_EQ(namesOf(*list.operator->()), (Names{"a", "b", "c"}));
    list->finish();
    EXPECT_EQ(list->lastError(), 0u);
    ASSERT_NE(list->next(), nullptr);
    list->finish();
    list->finish();
    EXPECT_EQ(namesOf(*list.operator->()), (Names{"a", "b", "c"})) << "broken off in the middle";
}

TEST_F(DirIteratorInAFolder, lists_another_directory_after_its_path_was_replaced) {
    makeFolder(scratch / "one");
    makeFolder(scratch / "two");
    put(scratch / "one/a", "");
    put(scratch / "two/b", "");
    WideText const two = here() + wide("\\two");
    DirIteratorW list(LOOK_ALL, (here() + wide("/one/")).c_str());
    EXPECT_EQ(namesOf(*list.operator->()), Names{"a"});
    list->setPath(two.c_str());
    list->finish();
    EXPECT_EQ(namesOf(*list.operator->()), Names{"b"});
    list->finish();
    EXPECT_EQ(plain(list->getPath().wstr()), plain(two.c_str()));
    list->setPath(WStr(two));
    EXPECT_EQ(plain(list->getPath().wstr()), plain(two.c_str()));
}

TEST_F(DirIteratorInAFolder, keeps_each_name_until_the_next) {
    for (int i = 0; i < 200; ++i) put(scratch / ("name " + std::to_string(i)), "");
    DirIteratorW list(LOOK_FILES, here().c_str());
    EXPECT_EQ(namesOf(*list.operator->()).size(), 200u);
}

TEST_F(DirIteratorInAFolder, is_given_up_in_the_middle) {
    for (char const* name : {"a", "b", "c"}) put(scratch / name, "");
    for (int i = 0; i < 3000; ++i) { // more than a process may hold open
        DirIteratorW list(LOOK_ALL, here().c_str());
        ASSERT_NE(list->next(), nullptr) << i;
    }
}

TEST_F(DirIteratorInAFolder, knows_sizes_above_four_gigabytes) {
    put(scratch / "large", "x");
    std::uint64_t const size = (std::uint64_t{6} << 30) + 1;
    std::filesystem::resize_file(scratch / "large", size);
    DirIteratorW list(LOOK_ALL, here().c_str());
    ASSERT_NE(list->next(), nullptr);
    EXPECT_EQ(list->size(), size);
}

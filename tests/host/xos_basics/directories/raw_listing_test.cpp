#include "tests/host/xos_basics/directories/listing.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>

TEST(HostListing, gives_the_names_of_a_folder) {
    Scratch const scratch;
    put(scratch / "a", "");
    makeFolder(scratch / "d/below");
    EXPECT_EQ(listed(scratch.path()), (Names{"a", "d"}));
}

TEST(HostListing, ends_for_good_in_an_empty_folder) {
    Scratch const scratch;
    xos_Dir const listing = xos_DirOpenEx(scratch.path().c_str(), nullptr, 0);
    ASSERT_NE(listing, 0U);
    for (int round = 0; round < 3; ++round) { EXPECT_EQ(xos_DirNextEx(listing, ALL, 0, 0x4000), nullptr); }
    xos_DirClose(listing);
}

TEST(HostListing, tells_files_from_directories) {
    Scratch const scratch;
    put(scratch / "a.txt", "");
    put(scratch / "b", "");
    makeFolder(scratch / "c.txt");
    makeFolder(scratch / "d");
    EXPECT_EQ(listed(scratch.path(), nullptr, ALL), (Names{"a.txt", "b", "c.txt", "d"}));
    EXPECT_EQ(listed(scratch.path(), nullptr, DIRECTORIES), (Names{"c.txt", "d"}));
    EXPECT_EQ(listed(scratch.path(), nullptr, FILES), (Names{"a.txt", "b"}));
    EXPECT_EQ(listed(scratch.path(), "*.txt", ALL), (Names{"a.txt", "c.txt"}));
    EXPECT_EQ(listed(scratch.path(), "*.txt", DIRECTORIES), Names{"c.txt"});
    EXPECT_EQ(listed(scratch.path(), "*.txt", FILES), Names{"a.txt"});
    for (int kind : {3, -1, 100}) { EXPECT_EQ(listed(scratch.path(), nullptr, kind), Names{}) << kind; }
}

TEST(HostListing, may_change_the_kind_asked_for_between_two_names) {
    Scratch const scratch;
    for (char const* name : {"a", "b", "c"}) {
        put(scratch / name, "");
        makeFolder(scratch / (std::string{"d"} + name));
    }
    xos_Dir const listing = xos_DirOpenEx(scratch.path().c_str(), nullptr, 0);
    char const* const file = xos_DirNextEx(listing, FILES, 0, 0);
    ASSERT_NE(file, nullptr);
    EXPECT_EQ(std::string{file}.size(), 1U);
    char const* const any = xos_DirNextEx(listing, ALL, 0, 0);
    EXPECT_NE(any, nullptr);
    xos_DirClose(listing);
}

TEST(HostListing, matches_patterns_by_the_librarys_own_rule) {
    struct Case {
        Row row;
        char const* pattern;
        bool anyCase;
        Names names;
    };
    Scratch const scratch;
    Names const all{"note.txt", "Note.TXT2", "noext", "a.b.c", "[x]", ".hidden"};
    for (std::string const& name : all) { put(scratch / name, ""); }
    for (Case const& c : {
             Case{{}, nullptr, false, all},
             Case{{}, "", false, all},
             Case{{}, "*", false, all},
             // a dot is a letter like others: names without one do not match
             Case{{}, "*.*", false, {"note.txt", "Note.TXT2", "a.b.c", ".hidden"}},
             Case{{}, "*.", false, {}},
             Case{{}, "*.txt", false, {"note.txt"}},
             Case{{}, "*.TXT", false, {}},
             Case{{}, "*.TXT", true, {"note.txt"}},
             Case{{}, "note*", true, {"note.txt", "Note.TXT2"}},
             Case{{}, "N*", false, {"Note.TXT2"}},
             Case{{}, "?o*", false, {"note.txt", "Note.TXT2", "noext"}},
             Case{{}, "*t", false, {"note.txt", "noext"}},
             Case{{}, "*.???", false, {"note.txt", "a.b.c"}},
             Case{{}, "a.*", false, {"a.b.c"}},
             Case{{}, "[x]", false, {"[x]"}},
             Case{{}, "[*", false, {"[x]"}},
             Case{{}, "*.txt2", true, {"Note.TXT2"}},
             Case{{}, "missing", false, {}},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(listed(scratch.path(), c.pattern, ALL, c.anyCase), c.names);
    }
}

TEST(HostListing, can_go_back_to_telling_cases_apart) {
    Scratch const scratch;
    put(scratch / "A", "");
    xos_Dir const listing = xos_DirOpenEx(scratch.path().c_str(), "a", 0);
    xos_DirForceCaseAny(listing, 1);
    xos_DirForceCaseAny(listing, 0);
    EXPECT_EQ(xos_DirNextEx(listing, ALL, 0, 0), nullptr);
    xos_DirClose(listing);
}

TEST(HostListing, opens_whatever_the_flags_and_the_slashes) {
    Scratch const scratch;
    put(scratch / "a", "");
    std::string backslashes = scratch.path() + "\\";
    std::replace(backslashes.begin(), backslashes.end(), '/', '\\');
    for (std::string const& path : {scratch.path(), scratch.path() + "/", scratch / ".", backslashes}) {
        xos_Dir const listing = xos_DirOpenEx(path.c_str(), nullptr, 0x4000000);
        ASSERT_NE(listing, 0U) << path;
        EXPECT_STREQ(xos_DirNextEx(listing, ALL, 0, 0x4000), "a");
        EXPECT_EQ(xos_DirNextEx(listing, ALL, 0, 0), nullptr);
        xos_DirClose(listing);
    }
}

TEST(HostListing, fails_for_what_is_no_directory) {
    Scratch const scratch;
    put(scratch / "file", "");
    for (std::string const& path : {scratch / "missing", scratch / "no/such", scratch / "file", std::string{}}) {
        clearSystemError();
        EXPECT_EQ(xos_DirOpenEx(path.c_str(), nullptr, 0), 0U) << path;
        EXPECT_NE(systemError(), 0) << path;
    }
    clearSystemError();
    EXPECT_EQ(xos_DirOpenEx(nullptr, nullptr, 0), 0U);
    EXPECT_NE(systemError(), 0);
}

TEST(HostListing, has_nothing_on_no_handle) {
    clearSystemError();
    EXPECT_EQ(xos_DirNextEx(0, ALL, 0, 0), nullptr);
    EXPECT_NE(systemError(), 0);
    xos_DirForceCaseAny(0, 1);
    xos_DirClose(0);
}

TEST(HostListing, gives_every_name_of_a_large_folder_once) {
    Scratch const scratch;
    Names all;
    // Several times what one call of the system returns. Under Wine the time grows with the square.
    for (int i = 0; i < 1'500; ++i) { all.insert("entry with a fairly long name number " + std::to_string(i)); }
    for (std::string const& name : all) { put(scratch / name, ""); }
    EXPECT_EQ(listed(scratch.path()), all);
    EXPECT_EQ(listed(scratch.path(), "*99", FILES).size(), 15U);
}

TEST(HostListing, keeps_a_name_until_the_next_call_on_its_handle) {
    Scratch const scratch;
    put(scratch / "a", "");
    xos_Dir const one = xos_DirOpenEx(scratch.path().c_str(), nullptr, 0);
    xos_Dir const two = xos_DirOpenEx(scratch.path().c_str(), nullptr, 0);
    char const* const name = xos_DirNextEx(one, ALL, 0, 0);
    EXPECT_STREQ(xos_DirNextEx(two, ALL, 0, 0), "a");
    EXPECT_EQ(xos_DirNextEx(two, ALL, 0, 0), nullptr);
    xos_DirClose(two);
    EXPECT_STREQ(name, "a");
    xos_DirClose(one);
}

TEST(HostListing, survives_the_removal_of_what_it_has_listed) {
    Scratch const scratch;
    for (int i = 0; i < 500; ++i) { put(scratch / std::to_string(i), ""); }
    xos_Dir const listing = xos_DirOpenEx(scratch.path().c_str(), nullptr, 0);
    int removed = 0;
    while (char const* const name = xos_DirNextEx(listing, FILES, 0, 0)) {
        removed += xos_FileRemove((scratch / name).c_str(), 0) == 0 ? 1 : 0;
    }
    xos_DirClose(listing);
    EXPECT_EQ(removed, 500);
    EXPECT_EQ(scratch.content(), Names{});
}

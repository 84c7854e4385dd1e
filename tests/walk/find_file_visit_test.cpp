#include <zor_basis/walk.h>

#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

bool matches(FindFileVisit& search, char const* name) {
    int const before = search.getNum();
    FileEntry entry(FStat::ST_FILE, Str("d"), name, 0, 0);
    EXPECT_TRUE(search.perform(&entry));
    return search.getNum() != before;
}

} // namespace

TEST(FindFile, breathes) {
    Scratch scratch;
    makeFolder(scratch / "d");
    put(scratch / "d/x.txt", "");
    FPath found;
    EXPECT_EQ(zbFindFile(Str(scratch.path()), "*.txt", LOOK_FILES, found, true, true), 1);
    EXPECT_STREQ(found, (scratch / "d/x.txt").c_str());
}

TEST(FindFile, gives_the_first_or_the_last_in_the_order_of_the_listing) {
    Scratch scratch;
    put(scratch / "1.txt", "");
    put(scratch / "2.txt", "");
    FileIterator list(scratch.path().c_str(), LOOK_FILES, nullptr, nullptr);
    std::string const first = scratch / list.next();
    std::string const last = scratch / list.next();
    FPath found;
    EXPECT_EQ(zbFindFile(Str(scratch.path()), "*.txt", LOOK_FILES, found, true, false), 1);
    EXPECT_EQ(found, first);
    EXPECT_EQ(zbFindFile(Str(scratch.path()), "*.txt", LOOK_FILES, found, false, false), 2);
    EXPECT_EQ(found, last);
    EXPECT_EQ(zbFindFile(Str(scratch.path()), "*.TXT", LOOK_FILES, found, false, false), 0);
    EXPECT_TRUE(found.empty());
    EXPECT_EQ(zbFindFile(Str(scratch.path()), "*.TXT", LOOK_FILES | LOOK_ANYCASE, found, false, false), 2);
    EXPECT_EQ(zbFindFile(Str(scratch.path()), nullptr, LOOK_ALL, found, false, true), 0) << "no directories";
}

TEST(FindFile, finds_nothing_in_a_missing_directory) {
    FPath found("old");
    EXPECT_EQ(zbFindFile(Str("no/such/directory"), "*", LOOK_BOTH, found, true, true), 0);
    EXPECT_TRUE(found.empty());
}

TEST(FindFileVisitKeys, match_in_either_case) {
    struct Case {
        Row row;
        bool byName;
        char const* key;
        char const* name;
        bool expected;
    };
    for (Case const& c : {
             Case{{}, false, "TXT", "a.txt", true},
             Case{{}, false, "TXT", "B.TxT", true},
             Case{{}, false, "TXT", ".txt", true},
             Case{{}, false, "TXT", "txt", false},
             Case{{}, false, "TXT", "a.txt2", false},
             Case{{}, false, "TXT", "atxt", false},
             Case{{}, false, "", "a.", true},
             Case{{}, false, "", "a", false},
             Case{{}, true, "Readme", "README", true},
             Case{{}, true, "Readme", "README.txt", false},
             Case{{}, true, "Readme", "aReadme", false},
             Case{{}, true, "Readme", "Readm", false},
             Case{{}, true, "", "anything", true},
         }) {
        SCOPED_TRACE(c.row);
        FindFileVisit search(false, 0);
        if (c.byName)
            search.searchName(c.key);
        else
            search.searchExt(c.key);
        EXPECT_EQ(matches(search, c.name), c.expected);
    }
}

TEST(FindFileVisitKeys, Kept_walk_09_put_a_dot_before_an_extension_that_has_one) {
    FindFileVisit search(false, 0);
    search.searchExt(Str(".txt"));
    EXPECT_FALSE(matches(search, "a.txt"));
    EXPECT_TRUE(matches(search, "a..TXT"));
}

TEST(FindFileVisitState, remembers_the_first_or_the_last_match) {
    FindFileVisit first(false, 2);
    FindFileVisit last(true, -1);
    for (char const* name : {"a", "b"}) {
        EXPECT_FALSE(first.stop());
        EXPECT_TRUE(matches(first, name));
        EXPECT_TRUE(matches(last, name));
    }
    EXPECT_TRUE(first.stop());
    EXPECT_FALSE(last.stop());
    EXPECT_STREQ(first.getPath(), "d/a");
    EXPECT_STREQ(last.getPath(), "d/b");
    first.searchName("q");
    first.clear();
    EXPECT_EQ(first.getNum(), 0);
    EXPECT_TRUE(first.getPath().empty());
    EXPECT_FALSE(first.stop());
    EXPECT_TRUE(matches(first, "any")) << "the key is gone";
}

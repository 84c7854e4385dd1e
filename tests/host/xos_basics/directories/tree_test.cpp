#include "basis/platform/xos_basics.h"
#include "tests/host/support/status.h"
#include "tests/support/random_steps.h"
#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <vector>

namespace {

constexpr std::uint32_t OVERWRITE = 0x001;
constexpr std::uint32_t RECURSIVE = 0x200;

int create(std::string const& path) { return xos_DirCreateEx(path.c_str(), 0); }
int removeTree(std::string const& path, std::uint32_t flags = RECURSIVE | 0x400) {
    return xos_DirRemove(path.c_str(), flags);
}
int copyTree(std::string const& dst, std::string const& src, std::uint32_t flags = RECURSIVE) {
    return xos_DirCopy(dst.c_str(), src.c_str(), flags);
}
int moveTree(std::string const& dst, std::string const& src, std::uint32_t flags = 0) {
    return xos_DirMove(dst.c_str(), src.c_str(), flags);
}

Names const SAMPLE{"a", "d/", "d/b", "d/e/", "d/e/c", "empty/"};

/// A tree of the sample's names; each file holds its own name and `mark`.
void makeSample(std::string const& top, std::string const& mark = "") {
    makeFolder(top + "/d/e");
    makeFolder(top + "/empty");
    for (char const* name : {"a", "d/b", "d/e/c"}) { put(top + "/" + name, name + mark); }
}

/// Checks that a call fails, says why, and changes nothing at all.
void failsCleanly(Scratch const& scratch, std::function<int()> const& call) {
    Names const before = scratch.content();
    clearSystemError();
    EXPECT_NE(call(), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(scratch.content(), before);
}

} // namespace

TEST(HostDirectory, is_made_copied_moved_and_removed) {
    Scratch const scratch;
    EXPECT_EQ(create(scratch / "one"), 0);
    put(scratch / "one/f", "text");
    EXPECT_EQ(copyTree(scratch / "two", scratch / "one"), 0);
    EXPECT_EQ(moveTree(scratch / "three", scratch / "two"), 0);
    EXPECT_EQ(textOf(scratch / "three/f"), "text");
    EXPECT_EQ(removeTree(scratch / "one"), 0);
    EXPECT_EQ(scratch.content(), (Names{"three/", "three/f"}));
}

TEST(HostDirectoryCreate, fails_on_anything_that_exists_and_without_a_parent) {
    Scratch const scratch;
    put(scratch / "f", "");
    makeFolder(scratch / "d");
    for (char const* name : {"f", "d", "d/", "no/such", "f/below"}) {
        SCOPED_TRACE(name);
        failsCleanly(scratch, [&] { return create(scratch / name); });
    }
    failsCleanly(scratch, [&] { return create(""); });
    failsCleanly(scratch, [&] { return xos_DirCreateEx(nullptr, 0); });
}

TEST(HostDirectoryCreate, takes_both_slashes) {
    Scratch const scratch;
    std::string path = scratch / "one\\two\\";
    EXPECT_EQ(create(scratch / "one"), 0);
    EXPECT_EQ(create(path), 0);
    EXPECT_EQ(scratch.content(), (Names{"one/", "one/two/"}));
}

TEST(HostDirectoryRemove, removes_an_empty_directory) {
    Scratch const scratch;
    for (std::uint32_t flags : {0U, 0x400U, 0x800U, 0x200U, 0x600U, 0xE00U}) {
        makeFolder(scratch / "d");
        EXPECT_EQ(removeTree(scratch / "d", flags), 0) << flags;
        EXPECT_EQ(scratch.content(), Names{});
    }
    makeFolder(scratch / "d");
    EXPECT_EQ(removeTree(scratch / "d\\", 0x400), 0);
    EXPECT_EQ(scratch.content(), Names{});
}

TEST(HostDirectoryRemove, removes_a_full_directory_only_when_told) {
    Scratch const scratch;
    makeSample(scratch / "d");
    failsCleanly(scratch, [&] { return removeTree(scratch / "d", 0x400 | 0x800); });
    EXPECT_EQ(removeTree(scratch / "d", 0x600), 0);
    EXPECT_EQ(scratch.content(), Names{});
}

TEST(HostDirectoryRemove, removes_what_is_write_protected) {
    Scratch const scratch;
    makeSample(scratch / "d");
    writeProtect(scratch / "d/d/b");
    EXPECT_EQ(removeTree(scratch / "d"), 0);
    EXPECT_EQ(scratch.content(), Names{});
}

TEST(HostDirectoryRemove, fails_for_files_and_for_what_is_missing) {
    Scratch const scratch;
    put(scratch / "f", "");
    for (std::uint32_t flags : {0U, 0x200U}) {
        for (char const* name : {"f", "missing", "no/such"}) {
            SCOPED_TRACE(name);
            failsCleanly(scratch, [&] { return removeTree(scratch / name, flags); });
        }
        failsCleanly(scratch, [&] { return removeTree("", flags); });
    }
    failsCleanly(scratch, [&] { return xos_DirRemove(nullptr, 0x200); });
}

TEST(HostDirectoryRemove, refuses_what_names_no_entry_and_empties_nothing) {
    Scratch const scratch;
    makeSample(scratch / "d");
    makeFolder(scratch / "d/e");
    for (char const* name : {"d/.", "d/e/..", "d/./", "d/e/../"}) {
        SCOPED_TRACE(name);
        failsCleanly(scratch, [&] { return removeTree(scratch / name); });
    }
}

TEST(HostDirectoryRemove, removes_many_entries_and_levels) {
    Scratch const scratch;
    std::string folder = scratch / "top";
    for (int level = 0; level < 60; ++level) {
        makeFolder(folder);
        for (int i = 0; i < 4; ++i) { put(folder + "/file" + std::to_string(i), "x"); }
        makeFolder(folder + "/side/more");
        folder += "/n";
    }
    EXPECT_EQ(removeTree(scratch / "top"), 0);
    EXPECT_EQ(scratch.content(), Names{});
}

TEST(HostDirectoryCopy, copies_a_whole_tree) {
    Scratch const scratch;
    makeSample(scratch / "from");
    EXPECT_EQ(copyTree(scratch / "to", scratch / "from"), 0);
    EXPECT_EQ(scratch.content("to"), SAMPLE);
    EXPECT_EQ(scratch.content("from"), SAMPLE);
    EXPECT_EQ(textOf(scratch / "to/d/e/c"), "d/e/c");
    EXPECT_EQ(Names({"from/", "to/"}), [&] {
        Names top;
        for (std::string const& name : scratch.content()) {
            if (name.find('/') == name.size() - 1) top.insert(name);
        }
        return top;
    }());
}

TEST(HostDirectoryCopy, copies_the_files_alone_when_not_told_more) {
    Scratch const scratch;
    makeSample(scratch / "from");
    put(scratch / "from/z", "z");
    EXPECT_EQ(copyTree(scratch / "to", scratch / "from", 0), 0);
    EXPECT_EQ(scratch.content("to"), (Names{"a", "z"}));
    EXPECT_EQ(copyTree(scratch / "to2", scratch / "from", OVERWRITE | 0x800), 0);
    EXPECT_EQ(scratch.content("to2"), (Names{"a", "z"}));
}

TEST(HostDirectoryCopy, keeps_permissions_and_times_of_files_and_new_directories) {
    Scratch const scratch;
    makeSample(scratch / "from");
    writeProtect(scratch / "from/d/b");
    for (char const* name : {"from/d/b", "from/d/e", "from/d", "from"}) {
        setAge(scratch / name, std::chrono::hours{3000});
    }
    EXPECT_EQ(copyTree(scratch / "to", scratch / "from"), 0);
    for (char const* name : {"", "/a", "/d", "/d/b", "/d/e"}) {
        SCOPED_TRACE(name);
        xos_Stat const from = statusOf((scratch / "from") + name);
        xos_Stat const to = statusOf((scratch / "to") + name);
        EXPECT_EQ(to.st_mode_, from.st_mode_);
        EXPECT_EQ(to.st_mtime_, from.st_mtime_);
    }
}

TEST(HostDirectoryCopy, merges_into_a_directory_that_is_there) {
    Scratch const scratch;
    makeSample(scratch / "from");
    makeFolder(scratch / "to/d");
    put(scratch / "to/own", "own");
    put(scratch / "to/d/own", "own");
    EXPECT_EQ(copyTree(scratch / "to", scratch / "from"), 0);
    Names expected = SAMPLE;
    expected.insert({"own", "d/own"});
    EXPECT_EQ(scratch.content("to"), expected);
    EXPECT_EQ(textOf(scratch / "to/d/own"), "own");
    EXPECT_EQ(textOf(scratch / "to/d/b"), "d/b");
}

TEST(HostDirectoryCopy, fails_on_an_existing_file_unless_it_may_overwrite) {
    Scratch const scratch;
    makeSample(scratch / "from", " new");
    makeFolder(scratch / "to/d");
    put(scratch / "to/d/b", "old");
    clearSystemError();
    EXPECT_NE(copyTree(scratch / "to", scratch / "from"), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(textOf(scratch / "to/d/b"), "old");
    EXPECT_EQ(copyTree(scratch / "to", scratch / "from", RECURSIVE | OVERWRITE), 0);
    EXPECT_EQ(textOf(scratch / "to/d/b"), "d/b new");
    EXPECT_EQ(scratch.content("to"), SAMPLE);
    // and once more, with everything there
    EXPECT_EQ(copyTree(scratch / "to", scratch / "from", RECURSIVE | OVERWRITE), 0);
    EXPECT_EQ(scratch.content("to"), SAMPLE);
}

TEST(HostDirectoryCopy, puts_neither_files_in_place_of_directories_nor_the_reverse) {
    for (char const* clash : {"a", "d"}) {
        SCOPED_TRACE(clash);
        Scratch const scratch;
        makeSample(scratch / "from");
        if (*clash == 'a') {
            makeFolder(scratch / "to/a");
            put(scratch / "to/a/own", "own");
        } else {
            makeFolder(scratch / "to");
            put(scratch / "to/d", "own");
        }
        EXPECT_NE(copyTree(scratch / "to", scratch / "from", RECURSIVE | OVERWRITE), 0);
        EXPECT_EQ(textOf(scratch / (*clash == 'a' ? "to/a/own" : "to/d")), "own");
    }
}

TEST(HostDirectoryCopy, refuses_to_copy_a_directory_into_itself) {
    struct Case {
        Row row;
        char const* dst;
        char const* src;
    };
    for (Case const& c : {
             Case{{}, "from", "from"},
             Case{{}, "from/", "from"},
             Case{{}, "from/new", "from"},
             Case{{}, "from/d", "from"},
             Case{{}, "from/d/e/new", "from"},
             Case{{}, "from/../from/d/new", "from/."},
         }) {
        SCOPED_TRACE(c.row);
        for (std::uint32_t flags : {0U, RECURSIVE, RECURSIVE | OVERWRITE}) {
            Scratch const scratch;
            makeSample(scratch / "from");
            failsCleanly(scratch, [&] { return copyTree(scratch / c.dst, scratch / c.src, flags); });
        }
    }
}

TEST(HostDirectoryCopy, copies_a_directory_over_the_one_it_lies_in) {
    Scratch const scratch;
    makeSample(scratch / "d");
    put(scratch / "d/d/a2", "a2");
    EXPECT_EQ(copyTree(scratch / "d", scratch / "d/d"), 0);
    EXPECT_EQ(textOf(scratch / "d/a2"), "a2");
    EXPECT_EQ(textOf(scratch / "d/e/c"), "d/e/c");
    // a sibling whose name begins alike is no part of it
    EXPECT_EQ(copyTree(scratch / "d2", scratch / "d"), 0);
}

TEST(HostDirectoryCopyAndMove, fail_and_leave_everything_as_it_was) {
    struct Case {
        Row row;
        char const* dst;
        char const* src;
    };
    for (Case const& c : {
             Case{{}, "new", "missing"},
             Case{{}, "other", "missing"},
             Case{{}, "new", "file"},
             Case{{}, "other", "file"},
             Case{{}, "file", "full"},
             Case{{}, "file/below", "full"},
             Case{{}, "no/such", "full"},
             Case{{}, "new", ""},
             Case{{}, "", "full"},
         }) {
        SCOPED_TRACE(c.row);
        for (auto operation : {copyTree, moveTree}) {
            for (std::uint32_t flags : {0U, OVERWRITE, RECURSIVE, RECURSIVE | OVERWRITE}) {
                Scratch const scratch;
                put(scratch / "file", "file");
                makeSample(scratch / "full");
                makeFolder(scratch / "other");
                std::string const dst = *c.dst == '\0' ? "" : scratch / c.dst;
                std::string const src = *c.src == '\0' ? "" : scratch / c.src;
                failsCleanly(scratch, [&] { return operation(dst, src, flags); });
            }
        }
    }
    Scratch const scratch;
    std::string const path = scratch.path();
    EXPECT_NE(xos_DirCopy(nullptr, path.c_str(), 0), 0);
    EXPECT_NE(xos_DirCopy(path.c_str(), nullptr, 0), 0);
    EXPECT_NE(xos_DirMove(nullptr, path.c_str(), 0), 0);
    EXPECT_NE(xos_DirMove(path.c_str(), nullptr, 0), 0);
}

TEST(HostDirectoryMove, gives_the_directory_its_new_name) {
    Scratch const scratch;
    makeSample(scratch / "from");
    makeFolder(scratch / "in");
    EXPECT_EQ(moveTree(scratch / "in/to", scratch / "from/"), 0);
    EXPECT_EQ(scratch.content("in/to"), SAMPLE);
    EXPECT_FALSE(exists(scratch / "from"));
}

TEST(HostDirectoryMove, replaces_a_directory_only_when_told) {
    for (bool full : {false, true}) {
        SCOPED_TRACE(full);
        Scratch const scratch;
        makeSample(scratch / "from");
        makeFolder(scratch / "to");
        if (full) makeSample(scratch / "to/old");
        failsCleanly(scratch, [&] { return moveTree(scratch / "to", scratch / "from", 0); });
        failsCleanly(scratch, [&] { return moveTree(scratch / "to", scratch / "from", 0x800); });
        EXPECT_EQ(moveTree(scratch / "to", scratch / "from", OVERWRITE), 0);
        EXPECT_EQ(scratch.content("to"), SAMPLE);
        EXPECT_EQ(scratch.content().size(), SAMPLE.size() + 1);
    }
}

TEST(HostDirectoryMove, fails_where_source_and_target_lie_in_each_other) {
    for (std::uint32_t flags : {0U, OVERWRITE}) {
        SCOPED_TRACE(flags);
        Scratch const scratch;
        makeSample(scratch / "a");
        failsCleanly(scratch, [&] { return moveTree(scratch / "a/new", scratch / "a", flags); });
        failsCleanly(scratch, [&] { return moveTree(scratch / "a/d", scratch / "a", flags); });
        failsCleanly(scratch, [&] { return moveTree(scratch / "a/d/e/new", scratch / "a", flags); });
        failsCleanly(scratch, [&] { return moveTree(scratch / "a", scratch / "a/d", flags); });
        failsCleanly(scratch, [&] { return moveTree(scratch / "a", scratch / "a/d/e", flags); });
    }
}

TEST(HostDirectoryMove, onto_itself_loses_nothing) {
    Scratch const scratch;
    makeSample(scratch / "a");
    failsCleanly(scratch, [&] { return moveTree(scratch / "a", scratch / "a", 0); });
    EXPECT_EQ(moveTree(scratch / "a", scratch / "a", OVERWRITE), 0);
    EXPECT_EQ(scratch.content("a"), SAMPLE);
}

TEST(HostDirectoryCopy, gives_what_it_was_given_for_random_trees) {
    std::mt19937_64 random = randomSource();
    std::uint64_t const trees = randomSteps(3);
    for (std::uint64_t tree = 0; tree < trees; ++tree) {
        SCOPED_TRACE(tree);
        Scratch const scratch;
        std::vector<std::string> folders{"from"};
        makeFolder(scratch / "from");
        for (int i = 0; i < 120; ++i) {
            std::string const parent = folders[random() % folders.size()];
            std::string const path = parent + "/n" + std::to_string(i);
            if (random() % 3 == 0) {
                makeFolder(scratch / path);
                folders.push_back(path);
            } else {
                put(scratch / path, std::string(random() % (random() % 10 == 0 ? 100'000 : 300), 'x') + path);
            }
        }
        Names const before = scratch.content("from");
        EXPECT_EQ(copyTree(scratch / "to", scratch / "from"), 0);
        EXPECT_EQ(scratch.content("to"), before);
        for (std::string const& name : before) {
            if (name.back() != '/') {
                EXPECT_TRUE(textOf(scratch / ("to/" + name)) == textOf(scratch / ("from/" + name))) << name;
            }
        }
        EXPECT_EQ(removeTree(scratch / "to"), 0);
        EXPECT_EQ(scratch.content("from"), before);
        EXPECT_FALSE(exists(scratch / "to"));
    }
}

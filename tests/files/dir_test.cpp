#include <zor_basis/files/dir.h>

#include <zor_basis/files/f_stat.h>
#include <zor_basis/files/wc_path.h>

#include "tests/files/last_call.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <pthread.h>

#include <functional>

using namespace ZOR_Basis;

namespace {

struct DirOnDisk : testing::Test {
    DirOnDisk() { xos_HostCallsReset(); }
    ~DirOnDisk() override { xos_HostFailClear(); }

    std::string at(std::string const& name) const { return scratch / name; }
    static std::string quoted(std::string const& text) { return "\"" + text + "\""; }
    static std::basic_string<WChar> wide(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }

    std::string last(char const* function) const { return lastCallIn(scratch, function); }

    Scratch scratch;
};

} // namespace

TEST_F(DirOnDisk, breathes) {
    std::string const folder = at("one/two three");
    EXPECT_FALSE(Dir::Exist(folder.c_str()));
    EXPECT_TRUE(Dir::New(folder.c_str(), true));
    EXPECT_TRUE(Dir::Exist(folder.c_str()));
    EXPECT_TRUE(Dir::Rem(folder.c_str(), false, false));
    EXPECT_FALSE(Dir::Exist(folder.c_str()));
    EXPECT_EQ(scratch.content(), Names{"one/"});
}

TEST_F(DirOnDisk, exists_for_entries_of_any_kind) {
    put(at("f"), "");
    EXPECT_TRUE(Dir::Exist(at("f").c_str()));
    EXPECT_TRUE(Dir::Exist(scratch.path().c_str()));
    EXPECT_FALSE(Dir::Exist(at("g").c_str()));
    EXPECT_FALSE(Dir::Exist(nullptr));
    EXPECT_FALSE(Dir::Exist(""));
}

TEST_F(DirOnDisk, is_made_by_one_call_of_the_platform) {
    EXPECT_TRUE(Dir::New(at("d").c_str(), false));
    EXPECT_EQ(last("xos_DirCreateEx"), "\"d\", 0");
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 1u);
    EXPECT_TRUE(Dir::New(at("d").c_str(), false)) << "there already";
    EXPECT_TRUE(Dir::New(at("d").c_str(), true));
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 1u) << "without the platform";
}

TEST_F(DirOnDisk, is_not_made_where_a_file_is) {
    put(at("f"), "text");
    EXPECT_FALSE(Dir::New(at("f").c_str(), false));
    EXPECT_FALSE(Dir::New(at("f").c_str(), true));
    EXPECT_FALSE(Dir::New(at("f/d").c_str(), true));
    EXPECT_FALSE(Dir::NewFor(at("f/d/x").c_str()));
    EXPECT_FALSE(Dir::NewFor(at("f/x").c_str()));
    EXPECT_EQ(textOf(at("f")), "text");
}

TEST_F(DirOnDisk, is_not_made_without_its_parents_unless_asked) {
    EXPECT_FALSE(Dir::New(at("a/b").c_str(), false));
    EXPECT_EQ(scratch.content(), Names{});
    EXPECT_TRUE(Dir::New(at("a/b").c_str(), true));
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/"}));
}

TEST_F(DirOnDisk, has_its_parents_made_from_the_top) {
    std::string const path = at("a/b/c/file");
    EXPECT_TRUE(Dir::NewFor(path.c_str()));
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/", "a/b/c/"}));
    // Tried upwards from the deepest, made downwards.
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 5u);
    EXPECT_EQ(last("xos_DirCreateEx"), "\"a/b/c\", 0");
}

TEST_F(DirOnDisk, has_its_parents_made_in_order) {
    // With each call failing in turn, what is there is always the top of the tree. The first three are tried again on
    // the way down.
    Names const whole{"a/", "a/b/", "a/b/c/"};
    std::vector<Names> const left = {whole, whole, whole, {"a/"}, {"a/", "a/b/"}, whole};
    for (std::uint32_t skip = 0; skip < left.size(); ++skip) {
        SCOPED_TRACE(skip);
        Dir::Rem(at("a").c_str(), true, false);
        ASSERT_EQ(xos_HostFail("xos_DirCreateEx", skip, 1), 0);
        EXPECT_EQ(Dir::NewFor(at("a/b/c/file").c_str()), left[skip].size() == 3);
        EXPECT_EQ(scratch.content(), left[skip]);
        xos_HostFailClear();
    }
}

TEST_F(DirOnDisk, has_parents_made_through_either_slash_kind_and_runs_of_them) {
    struct Case {
        Row row;
        char const* path;
        Names made;
        bool singleSlashes = true;
    };
    for (Case const& c : {
             Case{{}, "a\\b\\file", {"a/", "a/b/"}},
             Case{{}, "a/b\\file", {"a/", "a/b/"}},
             Case{{}, "a//b//file", {"a/", "a/b/"}, false},
             Case{{}, "a/b/", {"a/", "a/b/"}},
             Case{{}, "a/b//", {"a/", "a/b/"}, false},
             Case{{}, "with space/and more/x", {"with space/", "with space/and more/"}},
         }) {
        SCOPED_TRACE(c.row);
        Scratch own;
        EXPECT_TRUE(Dir::NewFor((own / c.path).c_str()));
        EXPECT_EQ(own.content(), c.made);
        // Under Windows the system's own status finds nothing where a path ends in a slash.
        if (!c.singleSlashes) continue;
        Scratch other;
        EXPECT_TRUE(Dir::NewForW(wide(other / c.path).c_str()));
        EXPECT_EQ(other.content(), c.made);
    }
}

TEST_F(DirOnDisk, looks_for_parents_without_deep_recursion) {
    put(at("f"), "");
    std::string path = at("f");
    for (int i = 0; i < 2000; ++i) path += "/a";
    auto const make = [](void* text) -> void* {
        std::string const& asked = *static_cast<std::string const*>(text);
        bool const made = Dir::NewFor(asked.c_str()) || Dir::NewForW(wide(asked).c_str());
        return made ? text : nullptr;
    };
    // Room for a few calls, not for one a component.
    pthread_attr_t attributes;
    pthread_attr_init(&attributes);
    pthread_attr_setstacksize(&attributes, 256 * 1024);
    pthread_t thread;
    ASSERT_EQ(pthread_create(&thread, &attributes, make, &path), 0);
    pthread_attr_destroy(&attributes);
    void* made = &path;
    pthread_join(thread, &made);
    EXPECT_EQ(made, nullptr);
    EXPECT_EQ(scratch.content(), Names{"f"});
}

TEST_F(DirOnDisk, Kept_dir_01_has_no_parent_to_make_without_a_slash) {
    EXPECT_FALSE(Dir::NewFor("zb-no-slash"));
    EXPECT_FALSE(Dir::New("zb-no-slash", true));
    EXPECT_FALSE(Dir::NewForW(ZB_W("zb-no-slash")));
    EXPECT_FALSE(Dir::NewW(ZB_W("zb-no-slash"), true));
    EXPECT_FALSE(Dir::NewFor(""));
    EXPECT_FALSE(Dir::NewFor(nullptr));
    EXPECT_FALSE(Dir::NewForW(nullptr));
    EXPECT_FALSE(Dir::New(nullptr, true));
    EXPECT_FALSE(Dir::NewW(nullptr, true));
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 0u);
    EXPECT_FALSE(Dir::Exist("zb-no-slash"));
}

TEST_F(DirOnDisk, Kept_dir_02_is_its_own_parent_behind_the_only_slash) {
    ASSERT_EQ(xos_HostFail("xos_DirCreateEx", 0, 1), 0);
    EXPECT_FALSE(Dir::NewFor("/zb-only-slash"));
    EXPECT_EQ(last("xos_DirCreateEx"), "\"/zb-only-slash\", 0");
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 1u) << "nothing is left to cut";
    EXPECT_FALSE(Dir::Exist("/zb-only-slash"));
}

TEST_F(DirOnDisk, is_made_by_wide_paths_without_the_platform) {
    EXPECT_FALSE(Dir::NewW(wide(at("a/b")).c_str(), false));
    EXPECT_TRUE(Dir::NewW(wide(at("a/b")).c_str(), true));
    EXPECT_TRUE(Dir::NewW(wide(at("a/b")).c_str(), true));
    EXPECT_TRUE(Dir::NewW(wide(at("a/b")).c_str(), false));
    EXPECT_TRUE(Dir::NewForW(wide(at("a/c/d/file")).c_str()));
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/", "a/c/", "a/c/d/"}));
    put(at("f"), "");
    EXPECT_FALSE(Dir::NewW(wide(at("f")).c_str(), false));
    EXPECT_FALSE(Dir::NewW(wide(at("f/d")).c_str(), true));
    EXPECT_FALSE(Dir::NewForW(wide(at("f/d")).c_str()));
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 0u);
}

TEST_F(DirOnDisk, is_removed_with_the_flags_of_its_arguments) {
    struct Case {
        Row row;
        bool recursive;
        bool flagB;
        char const* flags;
    };
    for (Case const& c : {
             Case{{}, false, false, "0x400"},
             Case{{}, true, false, "0x600"},
             Case{{}, false, true, "0xc00"},
             Case{{}, true, true, "0xe00"},
         }) {
        SCOPED_TRACE(c.row);
        makeFolder(at("d"));
        EXPECT_TRUE(Dir::Rem(at("d").c_str(), c.recursive, c.flagB));
        EXPECT_EQ(last("xos_DirRemove"), std::string("\"d\", ") + c.flags);
        EXPECT_FALSE(exists(at("d")));
    }
}

TEST_F(DirOnDisk, is_removed_with_its_contents_when_asked) {
    makeFolder(at("d/e"));
    put(at("d/e/f"), "1");
    EXPECT_FALSE(Dir::Rem(at("d").c_str(), false, false));
    EXPECT_EQ(scratch.content(), (Names{"d/", "d/e/", "d/e/f"}));
    EXPECT_TRUE(Dir::Rem(at("d").c_str(), true, false));
    EXPECT_EQ(scratch.content(), Names{});
}

TEST_F(DirOnDisk, counts_as_removed_where_nothing_is_and_never_removes_a_file) {
    put(at("f"), "1");
    EXPECT_TRUE(Dir::Rem(at("missing").c_str(), true, true));
    EXPECT_TRUE(Dir::Rem("", true, false));
    EXPECT_TRUE(Dir::Rem(nullptr, true, false));
    EXPECT_FALSE(Dir::Rem(at("f").c_str(), true, false));
    EXPECT_EQ(xos_HostCalls("xos_DirRemove"), 0u);
    EXPECT_TRUE(exists(at("f")));
}

TEST_F(DirOnDisk, is_copied_with_the_flags_of_its_arguments) {
    struct Case {
        Row row;
        bool recursive;
        bool overwrite;
        bool flagB;
        char const* flags;
    };
    makeFolder(at("d"));
    for (Case const& c : {
             Case{{}, false, false, false, "0x0"},
             Case{{}, true, false, false, "0x200"},
             Case{{}, false, true, false, "0x1"},
             Case{{}, false, false, true, "0x800"},
             Case{{}, true, true, true, "0xa01"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_TRUE(Dir::Copy(at("e").c_str(), at("d").c_str(), c.recursive, c.overwrite, c.flagB));
        EXPECT_EQ(last("xos_DirCopy"), std::string("\"e\", \"d\", ") + c.flags);
    }
    ASSERT_EQ(xos_HostFail("xos_DirCopy", 0, 1), 0);
    EXPECT_FALSE(Dir::Copy(at("e").c_str(), at("d").c_str(), true, true, false));
    EXPECT_EQ(xos_HostCalls("xos_DirMove"), 0u);
}

TEST_F(DirOnDisk, is_copied_with_its_tree) {
    makeFolder(at("d/e f"));
    put(at("d/e f/g"), "text");
    EXPECT_TRUE(Dir::Copy(at("copy").c_str(), at("d").c_str(), true, false, false));
    EXPECT_EQ(textOf(at("copy/e f/g")), "text");
    EXPECT_EQ(textOf(at("d/e f/g")), "text");
    EXPECT_FALSE(Dir::Copy(at("copy").c_str(), at("d").c_str(), true, false, false)) << "its file is there";
    EXPECT_TRUE(Dir::Copy(at("copy").c_str(), at("d").c_str(), true, true, false));
    EXPECT_FALSE(Dir::Copy(at("copy").c_str(), at("missing").c_str(), true, true, false));
}

TEST_F(DirOnDisk, is_moved_by_the_platform_if_that_can) {
    makeFolder(at("d"));
    put(at("d/f"), "1");
    EXPECT_TRUE(Dir::Move(at("e").c_str(), at("d").c_str(), false, false));
    EXPECT_EQ(last("xos_DirMove"), "\"e\", \"d\", 0x0");
    EXPECT_TRUE(Dir::Move(at("g").c_str(), at("e").c_str(), true, true));
    EXPECT_EQ(last("xos_DirMove"), "\"g\", \"e\", 0x801");
    EXPECT_EQ(scratch.content(), (Names{"g/", "g/f"}));
    EXPECT_EQ(xos_HostCalls("xos_DirCopy"), 0u);
    EXPECT_EQ(xos_HostCalls("xos_DirRemove"), 0u);
}

TEST_F(DirOnDisk, is_moved_by_copying_where_the_platform_cannot_move) {
    struct Case {
        Row row;
        bool overwrite;
        bool flagB;
        char const* copyFlags;
        char const* removeFlags;
    };
    for (Case const& c : {
             Case{{}, false, false, "0x200", "0x600"},
             Case{{}, true, false, "0x201", "0x600"},
             Case{{}, false, true, "0xa00", "0xe00"},
             Case{{}, true, true, "0xa01", "0xe00"},
         }) {
        SCOPED_TRACE(c.row);
        makeFolder(at("d/e"));
        put(at("d/e/f"), "1");
        ASSERT_EQ(xos_HostFail("xos_DirMove", 0, 1), 0);
        EXPECT_TRUE(Dir::Move(at("m").c_str(), at("d").c_str(), c.overwrite, c.flagB));
        EXPECT_EQ(last("xos_DirCopy"), std::string("\"m\", \"d\", ") + c.copyFlags);
        EXPECT_EQ(last("xos_DirRemove"), std::string("\"d\", ") + c.removeFlags);
        EXPECT_EQ(scratch.content(), (Names{"m/", "m/e/", "m/e/f"}));
        ASSERT_TRUE(Dir::Rem(at("m").c_str(), true, false));
    }
}

TEST_F(DirOnDisk, counts_as_moved_although_the_source_could_not_be_removed) {
    makeFolder(at("d"));
    ASSERT_EQ(xos_HostFail("xos_DirMove", 0, 1), 0);
    ASSERT_EQ(xos_HostFail("xos_DirRemove", 0, 1), 0);
    EXPECT_TRUE(Dir::Move(at("m").c_str(), at("d").c_str(), false, false));
    EXPECT_EQ(scratch.content(), (Names{"d/", "m/"}));
}

TEST_F(DirOnDisk, Kept_dir_03_is_lost_when_neither_moving_nor_copying_works) {
    makeFolder(at("d/e"));
    put(at("d/e/f"), "1");
    ASSERT_EQ(xos_HostFail("xos_DirMove", 0, 1), 0);
    ASSERT_EQ(xos_HostFail("xos_DirCopy", 0, 1), 0);
    EXPECT_FALSE(Dir::Move(at("m").c_str(), at("d").c_str(), false, false));
    EXPECT_EQ(scratch.content(), Names{});
}

TEST_F(DirOnDisk, links_with_the_source_first_at_the_platform) {
    put(at("f"), "1");
    EXPECT_TRUE(Dir::Link(at("g").c_str(), at("f").c_str()));
    EXPECT_EQ(last("xos_FileHardLink"), "\"f\", \"g\"");
    put(at("f"), "22");
    EXPECT_EQ(textOf(at("g")), "22");
    EXPECT_FALSE(Dir::Link(at("g").c_str(), at("f").c_str())) << "exists";
    EXPECT_FALSE(Dir::Link(at("h").c_str(), at("missing").c_str()));
}

TEST_F(DirOnDisk, is_split_at_the_deepest_existing_ancestor) {
    makeFolder(at("a/b"));
    put(at("a/f"), "");
    struct Case {
        Row row;
        std::string path;
        bool found;
        std::string existing;
        std::string rest;
    };
    std::string const s = scratch.path();
    for (Case const& c : {
             Case{{}, s + "/a/b/x/y", true, s + "/a/b", "x/y"},
             Case{{}, s + "/a/x/y/z", true, s + "/a", "x/y/z"},
             Case{{}, s + "/x", true, s, "x"},
             Case{{}, s + "/a/b/x", true, s + "/a/b", "x"},
             Case{{}, s + "\\a\\b\\x\\y", true, s + "\\a\\b", "x\\y"},
             // What exists itself is still a rest, as only what ends at an earlier slash is looked at.
             Case{{}, s + "/a/b", true, s + "/a", "b"},
             Case{{}, s + "/a/f", true, s + "/a", "f"},
             // A file is an existing entry like any other.
             Case{{}, s + "/a/f/x", true, s + "/a/f", "x"},
             // Slashes at the end belong to what exists, and are part of what does not.
             Case{{}, s + "/a/b/", true, s + "/a", "b"},
             Case{{}, s + "/a/b//", true, s + "/a", "b"},
             Case{{}, s + "/a/b/x/", true, s + "/a/b", "x/"},
             Case{{}, s + "/a//x", true, s + "/a/", "x"},
             Case{{}, "", false, "", ""},
             Case{{}, "/", false, "", ""},
             Case{{}, "ab", false, "", ""},
             // Where nothing is found, what the last look was at stays.
             Case{{}, "zb-missing", false, "zb-missing", ""},
             Case{{}, "zb-missing/x", false, "zb-missing", ""},
             Case{{}, "zb-missing/x/y", false, "zb-missing", ""},
             Case{{}, "/zb-missing/x", false, "/zb-missing", ""},
             Case{{}, "\\zb-missing\\x", false, "\\zb-missing", ""},
             Case{{}, "zb-missing/", false, "zb-missing/", ""},
             Case{{}, "zb-missing//", false, "zb-missing", ""},
             Case{{}, "zb-missing/x/", false, "zb-missing", ""},
             Case{{}, "./x", false, "./x", ""},
             Case{{}, "./zb-missing/", false, "./zb-missing/", ""},
             Case{{}, "..//", false, "..", ""},
             Case{{}, "./.", false, "./.", ""},
             Case{{}, "././", false, "./.", ""},
             Case{{}, "../x", true, "..", "x"},
         }) {
        SCOPED_TRACE(c.row);
        FPath existing("before");
        FPath rest("before");
        EXPECT_EQ(Dir::SplitCheck(c.path.c_str(), existing, rest), c.found);
        EXPECT_STREQ(existing.c_str(), c.existing.c_str());
        EXPECT_STREQ(rest.c_str(), c.rest.c_str());
        EXPECT_EQ(existing.size(), c.existing.size());
        EXPECT_EQ(rest.size(), c.rest.size());
    }
    FPath existing("before");
    FPath rest("before");
    EXPECT_FALSE(Dir::SplitCheck(nullptr, existing, rest));
    EXPECT_TRUE(existing.empty());
    EXPECT_TRUE(rest.empty());
}

TEST_F(DirOnDisk, Kept_dir_04_is_not_split_at_the_first_two_characters) {
    FPath existing;
    FPath rest;
    EXPECT_FALSE(Dir::SplitCheck("./zb-x", existing, rest)) << "the slash at index 1";
    EXPECT_FALSE(Dir::SplitCheck("/zb-x/", existing, rest)) << "the slash at index 0";
    EXPECT_FALSE(Dir::SplitCheck("//", existing, rest));
    EXPECT_FALSE(Dir::SplitCheck("///", existing, rest));
}

// Names are given and the common folder is chosen once in a process, so each case has a child of its own.

#include <zor_basis/system/vdp_temp_dir.h>

#include "tests/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <sstream>
#include <string>
#include <thread>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

using Steps = std::vector<std::string>;

struct TempDirs : testing::Test {
    /// What a child prints, the root's path replaced by "ROOT".
    std::string after(Steps const& steps, std::string const& faults = {}) const {
        ChildResult const result =
            run({"temp_dir_child", steps, {{"XOS_ROOT", root.path()}, {"XOS_FAULTS", faults}}, root.path()});
        EXPECT_EQ(result.exitCode, 0);
        std::string text = result.output;
        for (std::size_t i; (i = text.find(root.path())) != std::string::npos;)
            text.replace(i, root.path().size(), "ROOT");
        return text;
    }
    void makeShared(std::string const& path) const { makeFolder(root / ("tmp/vdp_tmp/" + path)); }

    Scratch root;
};

} // namespace

static_assert(sizeof(VDPTempDir) == sizeof(FPath) + 8);
static_assert(std::is_convertible_v<bool, VDPTempDir>, "folders stand in arrays by their flags");

TEST_F(TempDirs, breathe) {
    EXPECT_EQ(after({"make", "status", "make", "root"}), "ROOT/tmp/1.r\nthere\nROOT/tmp/2.r\nROOT/tmp\n");
    EXPECT_EQ(root.content(), Names{"tmp/"}) << "gone with their objects";
}

TEST_F(TempDirs, have_no_root_before_the_first) { EXPECT_EQ(after({"root"}), "\n"); }

TEST_F(TempDirs, are_named_after_the_instance) {
    EXPECT_EQ(after({"init=2", "root", "make", "make"}),
              "ROOT/tmp/vdp_tmp\nROOT/tmp/vdp_tmp/1.r2\nROOT/tmp/vdp_tmp/2.r2\n");
    EXPECT_EQ(after({"init=2147483647", "make"}), "ROOT/tmp/vdp_tmp/1.r2147483647\n");
    EXPECT_EQ(after({"init=10", "make"}), "ROOT/tmp/vdp_tmp/1.r10\n");
}

TEST_F(TempDirs, lie_in_the_temporary_folder_without_a_positive_number) {
    EXPECT_EQ(after({"init=0", "root", "make"}), "ROOT/tmp\nROOT/tmp/1.r\n");
    EXPECT_EQ(after({"init=-1", "root", "make"}), "ROOT/tmp\nROOT/tmp/1.r\n");
}

TEST_F(TempDirs, begin_empty_for_the_first_instance_only) {
    makeShared("old/deep");
    put(root / "tmp/vdp_tmp/file", "text");
    for (char const* number : {"init=0", "init=-1", "init=2", "init=11"}) {
        SCOPED_TRACE(number);
        after({number});
        EXPECT_TRUE(exists(root / "tmp/vdp_tmp/old/deep"));
    }
    after({"init=1"});
    EXPECT_EQ(root.content(), (Names{"tmp/", "tmp/vdp_tmp/"}));
}

TEST_F(TempDirs, have_their_common_folder_made_with_its_parents_for_the_first_instance_only) {
    after({"init=2"});
    EXPECT_EQ(root.content(), Names{});
    after({"init=1"});
    EXPECT_EQ(root.content(), (Names{"tmp/", "tmp/vdp_tmp/"}));
}

TEST_F(TempDirs, Kept_temp_01_keep_the_first_positive_number) {
    struct Case {
        Row row;
        Steps steps;
        char const* made;
    };
    for (Case const& c : {
             Case{{}, {"init=3", "init=4", "make"}, "ROOT/tmp/vdp_tmp/1.r3\n"},
             Case{{}, {"init=3", "init=0", "make"}, "ROOT/tmp/vdp_tmp/1.r3\n"},
             Case{{}, {"init=3", "init=-2", "make"}, "ROOT/tmp/vdp_tmp/1.r3\n"},
             Case{{}, {"init=3", "init=3", "make"}, "ROOT/tmp/vdp_tmp/1.r3\n"},
             Case{{}, {"init=0", "init=4", "make"}, "ROOT/tmp/vdp_tmp/1.r4\n"},
             Case{{}, {"init=0", "init=0", "init=-1", "init=4", "init=5", "make"}, "ROOT/tmp/vdp_tmp/1.r4\n"},
             Case{{}, {"make", "init=0", "make"}, "ROOT/tmp/1.r\nROOT/tmp/2.r\n"},
             // The numbers go on.
             Case{{},
                  {"make", "init=4", "make", "init=0", "make"},
                  "ROOT/tmp/1.r\nROOT/tmp/vdp_tmp/2.r4\nROOT/tmp/vdp_tmp/3.r4\n"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(after(c.steps), c.made);
    }
}

TEST_F(TempDirs, do_not_take_the_folder_from_under_those_who_have_one) {
    after({"init=2", "make", "init=1", "init=3", "put=file", "deletes=0"});
    EXPECT_EQ(root.content("tmp/vdp_tmp"), (Names{"1.r2/", "1.r2/file"}));
}

TEST_F(TempDirs, carry) {
    Steps steps;
    std::string made;
    for (int i = 1; i <= 101; ++i) {
        steps.insert(steps.end(), {"make", "drop"});
        made += "ROOT/tmp/" + std::to_string(i) + ".r\n";
    }
    EXPECT_EQ(after(steps), made);
    EXPECT_EQ(root.content(), Names{"tmp/"});
}

TEST_F(TempDirs, go_with_all_that_is_in_them) {
    makeFolder(root / "tmp/1.r/deep/er");
    put(root / "tmp/1.r/deep/file", "text");
    put(root / "tmp/other", "text");
    EXPECT_EQ(after({"make", "put=file", "drop", "last=xos_DirRemove"}), "ROOT/tmp/1.r\n\"ROOT/tmp/1.r\", 0x600\n");
    EXPECT_EQ(root.content("tmp"), Names{"other"});
}

TEST_F(TempDirs, stay_where_that_is_asked_for) {
    after({"keep", "make", "deletes=0", "make", "deletes=0", "deletes=1", "keep", "deletes=1"});
    EXPECT_EQ(root.content("tmp"), (Names{"1.r/", "2.r/"}));
}

TEST_F(TempDirs, are_made_without_an_object) {
    EXPECT_EQ(after({"create", "create", "make"}), "ROOT/tmp/1.r\nROOT/tmp/2.r\nROOT/tmp/3.r\n");
    EXPECT_EQ(root.content("tmp"), (Names{"1.r/", "2.r/"})) << "and are nobody's to remove";
}

TEST_F(TempDirs, Kept_temp_02_are_used_as_they_are) {
    makeFolder(root / "tmp/1.r");
    put(root / "tmp/1.r/file", "text");
    EXPECT_EQ(after({"make", "deletes=0"}), "ROOT/tmp/1.r\n");
    EXPECT_EQ(root.content("tmp"), (Names{"1.r/", "1.r/file"}));
}

TEST_F(TempDirs, have_the_next_name_where_a_file_is_in_the_way) {
    makeFolder(root / "tmp");
    put(root / "tmp/1.r", "text");
    put(root / "tmp/3.r", "text");
    EXPECT_EQ(after({"make", "make"}), "ROOT/tmp/2.r\nROOT/tmp/4.r\n");
    EXPECT_EQ(root.content("tmp"), (Names{"1.r", "3.r"}));
}

TEST_F(TempDirs, are_removed_only_where_they_are_directories) {
    EXPECT_EQ(after({"make", "replace", "status", "drop", "calls=xos_DirRemove"}), "ROOT/tmp/1.r\nthere\n0\n");
    EXPECT_EQ(root.content("tmp"), Names{"1.r"}) << "a file now";
}

TEST_F(TempDirs, Kept_temp_04_are_shared_by_copies) {
    after({"make", "copy", "drop", "status", "deletes=0"});
    EXPECT_EQ(root.content("tmp"), Names{}) << "the copy has deleted it";
    EXPECT_EQ(after({"make", "deletes=0", "copy", "deletes=1", "drop", "status"}), "ROOT/tmp/1.r\ngone\n");
    EXPECT_EQ(after({"keep", "copy", "status"}), "ROOT/tmp/1.r\nthere\n");
    EXPECT_EQ(root.content("tmp"), Names{"1.r/"}) << "the flag is copied as well";
}

TEST_F(TempDirs, Kept_temp_04_are_shared_by_assignments) {
    EXPECT_EQ(after({"make", "assign", "status"}), "ROOT/tmp/1.r\nROOT/tmp/2.r\nthere\n");
    EXPECT_EQ(root.content("tmp"), Names{"2.r/"}) << "left behind";
}

/* Faults */

TEST_F(TempDirs, have_the_next_name_where_the_platform_makes_none) {
    makeFolder(root / "tmp");
    for (int failures = 0; failures < 12; ++failures) {
        SCOPED_TRACE(failures);
        EXPECT_EQ(after({"make"}, "xos_DirCreateEx:0:" + std::to_string(failures)),
                  "ROOT/tmp/" + std::to_string(failures + 1) + ".r\n");
    }
}

TEST_F(TempDirs, have_their_parents_made_first) {
    // The first call is for the folder above, and so is the second, when the one above that is there.
    EXPECT_EQ(after({"make"}, "xos_DirCreateEx:0:1"), "ROOT/tmp/1.r\n");
    std::filesystem::remove(root / "tmp");
    EXPECT_EQ(after({"make"}, "xos_DirCreateEx:0:2"), "ROOT/tmp/2.r\n");
    EXPECT_EQ(root.content(), Names{"tmp/"});
}

TEST_F(TempDirs, are_made_without_semaphores_too) {
    for (char const* fault : {"xos_SemNamedMutexCreate:0:9", "xos_SemMCreate:0:9", "xos_SemTake:0:9", "xos_SemGive:0:9",
                              "xos_FileStatByNameEx:0:9"}) {
        SCOPED_TRACE(fault);
        EXPECT_EQ(after({"make", "make"}, fault), "ROOT/tmp/1.r\nROOT/tmp/2.r\n");
        EXPECT_EQ(after({"init=2", "init=3", "make", "make"}, fault), "ROOT/tmp/vdp_tmp/1.r2\nROOT/tmp/vdp_tmp/2.r2\n");
    }
}

TEST_F(TempDirs, make_their_semaphore_when_it_can_be_made) {
    EXPECT_EQ(after({"make", "make", "make", "calls=xos_SemMCreate"}, "xos_SemMCreate:0:1"),
              "ROOT/tmp/1.r\nROOT/tmp/2.r\nROOT/tmp/3.r\n2\n");
}

TEST_F(TempDirs, stay_where_they_cannot_be_removed) {
    EXPECT_EQ(after({"make", "put=file", "drop", "make"}, "xos_DirRemove:0:1"), "ROOT/tmp/1.r\nROOT/tmp/2.r\n");
    EXPECT_EQ(root.content("tmp"), (Names{"1.r/", "1.r/file"}));
}

TEST_F(TempDirs, begin_in_what_is_there_where_the_first_instance_cannot_clear_it) {
    makeShared("1.r1/old");
    EXPECT_EQ(after({"init=1", "make", "make"}, "xos_DirRemove:0:1"), "ROOT/tmp/vdp_tmp/1.r1\nROOT/tmp/vdp_tmp/2.r1\n");
}

TEST_F(TempDirs, ask_the_platform_for_one_mutex_of_all_processes) {
    EXPECT_EQ(after({"init=2", "last=xos_SemNamedMutexCreate"}).substr(0, 13), "264, 0x0, 0, ");
    EXPECT_EQ(after({"make", "last=xos_SemNamedMutexCreate"}).substr(13, 13), "264, 0x0, 0, ");
    EXPECT_EQ(after({"init=2", "make", "make", "init=3", "init=0", "calls=xos_SemNamedMutexCreate",
                     "calls=xos_SemMCreate", "last=xos_DirCreateEx"}),
              "ROOT/tmp/vdp_tmp/1.r2\nROOT/tmp/vdp_tmp/2.r2\n1\n1\n\"ROOT/tmp/vdp_tmp/2.r2\", 0\n");
}

TEST_F(TempDirs, ask_nobody_where_a_folder_has_been_chosen) {
    EXPECT_EQ(after({"make", "init=0", "calls=xos_SemNamedMutexCreate"}), "ROOT/tmp/1.r\n1\n");
    EXPECT_EQ(after({"init=0", "init=0", "calls=xos_SemNamedMutexCreate"}), "1\n");
    // Without a semaphore it takes a look at what has been chosen, and leaves it at that.
    EXPECT_EQ(
        after({"init=0", "init=0", "calls=xos_SemNamedMutexCreate", "calls=xos_SemMCreate"}, "xos_SemMCreate:0:9"),
        "2\n1\n");
}

TEST_F(TempDirs, are_made_by_one_thread_at_a_time) {
    Steps const calls = {"calls=xos_SemTake", "calls=xos_SemGive"};
    Steps steps = {"make"};
    steps.insert(steps.end(), calls.begin(), calls.end());
    steps.push_back("make");
    steps.insert(steps.end(), calls.begin(), calls.end());
    EXPECT_EQ(after(steps), "ROOT/tmp/1.r\n2\n2\nROOT/tmp/2.r\n3\n3\n");
}

TEST_F(TempDirs, Kept_temp_03_try_until_a_folder_can_be_made) {
    put(root / "tmp", "a file where the folder would be");
    std::string const made = after({"unblock=" + (root / "tmp"), "make"});
    ASSERT_EQ(made.substr(0, 9), "ROOT/tmp/");
    EXPECT_GE(std::stoul(made.substr(9)), 100u) << made;
    EXPECT_EQ(root.content(), Names{"tmp/"});
}

TEST_F(TempDirs, do_not_keep_the_common_folder_from_being_chosen_while_one_is_tried_in_vain) {
    put(root / "tmp", "a file where the folder would be");
    std::string const made =
        after({"background", "tried=3", "init=2", "root", "tried=3", "remove=" + (root / "tmp"), "join"});
    EXPECT_EQ(made.substr(0, made.find_first_of("0123456789")), "ROOT/tmp/vdp_tmp\nROOT/tmp/vdp_tmp/");
    EXPECT_EQ(made.substr(made.rfind('.')), ".r2\n") << "its next name is of the new kind";
    EXPECT_EQ(after({"make"}), "ROOT/tmp/1.r\n") << "another process is not kept waiting";
}

/* Many at once */

TEST_F(TempDirs, are_distinct_for_threads_and_processes) {
    constexpr int PROCESSES = 4;
    makeShared("old");
    std::vector<std::string> made(PROCESSES);
    std::vector<std::thread> processes;
    for (int i = 0; i < PROCESSES; ++i) {
        std::string const init = "init=" + std::to_string(i + 1);
        // The first one clears the folder before the others begin.
        Steps const steps = i == 0 ? Steps{init, "touch=" + (root / "cleared"), "threads=8"}
                                   : Steps{"wait=" + (root / "cleared"), init, "threads=8"};
        processes.emplace_back([this, &made, i, steps] { made[static_cast<std::size_t>(i)] = after(steps); });
    }
    for (std::thread& process : processes) process.join();

    std::set<std::string> names;
    for (int i = 0; i < PROCESSES; ++i) {
        std::istringstream lines(made[static_cast<std::size_t>(i)]);
        std::string const suffix = ".r" + std::to_string(i + 1);
        for (std::string line; std::getline(lines, line);) {
            EXPECT_EQ(line.substr(0, 17), "ROOT/tmp/vdp_tmp/");
            EXPECT_EQ(line.substr(line.rfind('.')), suffix);
            EXPECT_TRUE(names.insert(line).second) << line;
        }
    }
    EXPECT_EQ(names.size(), PROCESSES * 8 * 25u);
    EXPECT_EQ(root.content(), (Names{"cleared", "tmp/", "tmp/vdp_tmp/"})) << "everything is gone";
}

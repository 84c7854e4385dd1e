// The registry is made once in a process, so each case runs a child process.

#include "tests/support/child.h"
#include "tests/support/scratch_root.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

namespace fs = std::filesystem;

namespace {

/// A root of its own for each case.
class TimerMgrMgrOnce : public testing::Test {
protected:
    TimerMgrMgrOnce() { fs::create_directories(root_); }

    std::string after(std::vector<std::string> const& steps, std::string const& root, std::string const& faults = {}) {
        ChildResult const result =
            run({"timers_child", steps, {{"XOS_ROOT", root}, {"XOS_FAULTS", faults}}, root_.string()});
        EXPECT_EQ(result.exitCode, 0);
        return result.output;
    }
    std::string after(std::vector<std::string> const& steps) { return after(steps, root_.generic_string()); }

    using Names = std::set<std::string>;

    /// The names without their seconds: two reports make one file or two, depending on the clock.
    Names reports(fs::path const& folder) {
        Names names;
        for (auto const& entry : fs::directory_iterator(folder)) {
            std::string const name = entry.path().filename().string();
            names.insert(name.substr(name.find('_')));
        }
        return names;
    }

    fs::path const root_ = scratchRoot() / testing::UnitTest::GetInstance()->current_test_info()->name();
};

} // namespace

TEST_F(TimerMgrMgrOnce, makes_its_folder_with_the_first_of_all_calls) {
    after({});
    EXPECT_FALSE(fs::exists(root_ / "timer")) << "not before";
    for (char const* step : {"mgr", "new", "get", "rip=0"}) {
        SCOPED_TRACE(step);
        fs::remove_all(root_ / "timer");
        after({step});
        EXPECT_TRUE(fs::is_directory(root_ / "timer"));
        after({step, "report"});
    }
}

TEST_F(TimerMgrMgrOnce, Kept_timers_11_the_first_rip_number_other_than_0_stays) {
    after({"new", "report", "rip=0", "report", "rip=7", "rip=9", "rip=0", "report"});
    EXPECT_EQ(reports(root_ / "timer"), (Names{"_child_0.timer", "_child_7.timer"}));
}

TEST_F(TimerMgrMgrOnce, takes_a_negative_rip_number) {
    after({"rip=-3", "rip=4", "new", "report"});
    EXPECT_EQ(reports(root_ / "timer"), (Names{"_child_-3.timer"}));
}

TEST_F(TimerMgrMgrOnce, goes_on_without_a_folder) {
    std::string const root = root_.generic_string();
    EXPECT_EQ(after({"new", "report", "get"}, root, "xos_DirCreateEx:0:2"), "report\nfound\n");
    EXPECT_FALSE(fs::exists(root_ / "timer"));
    EXPECT_EQ(after({"new", "report", "get"}, root, "xos_DirCreateEx:0:1"), "report\nfound\n");
    EXPECT_EQ(reports(root_ / "timer"), (Names{"_child_0.timer"}))
        << "the report makes the folder that the registry could not make";
    EXPECT_EQ(after({"new", "report", "get"}, (root_ / "missing").generic_string()), "report\nfound\n");
    EXPECT_FALSE(fs::exists(root_ / "missing")) << "parents are not made";
}

TEST_F(TimerMgrMgrOnce, goes_on_without_semaphores) {
    EXPECT_EQ(after({"new", "report", "get", "rip=5", "report"}, root_.generic_string(), "xos_SemMCreate:0:100"),
              "report\nfound\nreport\n");
    EXPECT_EQ(reports(root_ / "timer"), (Names{"_child_0.timer", "_child_5.timer"}));
}

TEST_F(TimerMgrMgrOnce, makes_one_registry_for_many_threads) { EXPECT_EQ(after({"race"}), "one\n"); }

TEST_F(TimerMgrMgrOnce, uses_the_current_folder_without_a_configured_root) {
    after({"new", "report"}, "");
    EXPECT_EQ(reports(root_ / "timer"), (Names{"_child_0.timer"}));
}

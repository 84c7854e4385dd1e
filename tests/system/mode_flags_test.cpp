// The flags are read once in a process, so each case has a child of its own.

#include "tests/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

using Steps = std::vector<std::string>;

struct ModeFlags : testing::Test {
    /// Writes the group into a folder of its own.
    std::string configured(std::string const& name, std::string const& text) const {
        makeFolder(scratch / name);
        put(scratch / (name + "/vdp.cfg"), text);
        return scratch / name;
    }
    std::string after(Steps const& steps, std::string const& folder, std::string const& faults = {}) const {
        ChildResult const result = run({"flags_child", steps, {{"XOS_CONFIG", folder}, {"XOS_FAULTS", faults}}, {}});
        EXPECT_EQ(result.exitCode, 0);
        return result.output;
    }

    Scratch scratch;
};

} // namespace

TEST_F(ModeFlags, breathe) {
    EXPECT_EQ(after({"vipp", "ppml", "vps", "qdb", "vdp"}, configured("a", "vipp = true\n")), "1\n0\n0\n0\n1\n");
}

TEST_F(ModeFlags, each_have_a_key) {
    struct Case {
        Row row;
        char const *text, *flags;
    };
    for (Case const& c : {
             Case{{}, "vps = 1", "1\n0\n0\n0\n1\n"},
             Case{{}, "qdb = 1", "0\n1\n0\n0\n1\n"},
             Case{{}, "vipp = 1", "0\n0\n1\n0\n1\n"},
             Case{{}, "ppml = 1", "0\n0\n0\n1\n1\n"},
             Case{{}, "vps=yes\nqdb=on\nvipp=true\nppml=1", "1\n1\n1\n1\n1\n"},
             Case{{}, "vps=yes\nqdb=no\nvipp=true\nppml=0", "1\n0\n1\n0\n1\n"},
             Case{{}, "vps=0\nqdb=no\nvipp=false\nppml=off", "0\n0\n0\n0\n0\n"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(after({"vps", "qdb", "vipp", "ppml", "vdp"}, configured("a", c.text)), c.flags);
    }
}

TEST_F(ModeFlags, Kept_flat_05_are_all_on_without_a_group_and_off_without_a_key) {
    EXPECT_EQ(after({"ppml", "vps", "qdb", "vipp", "vdp"}, scratch / "none"), "1\n1\n1\n1\n1\n");
    EXPECT_EQ(after({"ppml", "vps", "qdb", "vipp", "vdp"}, configured("a", "")), "0\n0\n0\n0\n0\n");
}

TEST_F(ModeFlags, Kept_flat_04_are_not_read_for_the_question_after_all_of_them) {
    EXPECT_EQ(after({"loaded", "vdp", "loaded", "calls", "ppml", "vdp", "loaded"}, scratch / "none"),
              "0\n0\n0\n0 loads, 0 readings, 0 releases\n1\n1\n1\n");
    EXPECT_EQ(after({"vdp", "set", "vdp", "loaded"}, configured("a", "qdb = on")), "0\n0\n1\n1\n");
}

TEST_F(ModeFlags, are_read_once_whichever_is_asked_for_first) {
    for (char const* first : {"vps", "qdb", "vipp", "ppml", "set"}) {
        SCOPED_TRACE(first);
        EXPECT_EQ(after({first, "vps", "qdb", "vipp", "ppml", "vdp", "loaded", "calls"}, configured("a", "")),
                  "0\n0\n0\n0\n0\n0\n1\n1 loads, 4 readings, 1 releases\n");
        EXPECT_EQ(after({first, "vps", "qdb", "vipp", "ppml", "vdp", "loaded", "calls"}, scratch / "none"),
                  std::string(first == std::string("set") ? "0" : "1") +
                      "\n1\n1\n1\n1\n1\n1\n1 loads, 0 readings, 0 releases\n");
    }
}

TEST_F(ModeFlags, are_read_anew_when_that_is_asked_for) {
    std::string const vps = "config=" + configured("vps", "vps = on");
    std::string const qdb = "config=" + configured("qdb", "qdb = on");
    std::string const none = "config=" + (scratch / "none");
    Steps const all = {"vps", "qdb", "vipp", "ppml", "vdp"};
    Steps steps;
    for (std::string const& folder : {vps, qdb, none, qdb}) {
        steps.insert(steps.end(), {folder, "vps", "set"});
        steps.insert(steps.end(), all.begin(), all.end());
    }
    steps.push_back("calls");
    EXPECT_EQ(after(steps, scratch / "none"), "1\n0\n1\n0\n0\n0\n1\n"
                                              "1\n0\n0\n1\n0\n0\n1\n"
                                              "0\n0\n1\n1\n1\n1\n1\n"
                                              "1\n0\n0\n1\n0\n0\n1\n"
                                              "5 loads, 16 readings, 4 releases\n");
}

TEST_F(ModeFlags, are_asked_of_the_platform_so) {
    EXPECT_EQ(after({"set", "last"}, configured("a", "")), "0\nload \"vdp\", 0, 0, 0\nreading \"qdb\", 0\nrelease 0\n");
}

TEST_F(ModeFlags, are_on_where_the_group_cannot_be_loaded) {
    EXPECT_EQ(after({"vps", "vdp", "set", "vps", "vdp"}, configured("a", ""), "cfg_GroupLoadFromFile:0:1"),
              "1\n1\n0\n0\n0\n");
}

TEST_F(ModeFlags, are_off_where_their_key_cannot_be_read) {
    // In the order in which the keys are read.
    std::string const all = configured("a", "vps=1\nqdb=1\nvipp=1\nppml=1");
    char const* const expected[] = {"0\n1\n1\n1\n1\n", "1\n0\n1\n1\n1\n", "1\n1\n0\n1\n1\n", "1\n1\n1\n0\n1\n"};
    for (int failing = 0; failing < 4; ++failing) {
        SCOPED_TRACE(failing);
        std::string const fault = "cfg_KeyGetOpt_Bool:" + std::to_string(failing) + ":1";
        EXPECT_EQ(after({"vipp", "ppml", "vps", "qdb", "vdp"}, all, fault), expected[failing]);
    }
}

TEST_F(ModeFlags, are_the_same_for_threads_that_ask_at_once) {
    EXPECT_EQ(after({"race"}, configured("a", "vipp=1")), "11111111\n");
    EXPECT_EQ(after({"race"}, configured("a", "ppml=1")), "00000000\n");
    EXPECT_EQ(after({"race"}, scratch / "none"), "11111111\n");
}

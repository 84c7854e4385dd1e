// The lines that a log holds when its process ends.

#include "tests/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <sstream>
#include <string>

namespace {

constexpr int LINES = 2001;

class ProcessEndOfLogs : public testing::Test {
protected:
    void endBy(char const* how) const {
        ChildResult const result = run({"log_end_child", {how}, {{"XOS_ROOT", root.path()}}, root.path()});
        EXPECT_EQ(result.exitCode, 0);
    }
    std::string file(int session) const { return root / ("tmp/zb_log/child/" + std::to_string(session) + ".log"); }
    bool isThere(int session) const { return std::filesystem::exists(file(session)); }
    std::string textOfAll() const {
        std::string all;
        for (int session = 0; isThere(session); ++session) all += textOf(file(session));
        return all;
    }

    Scratch root;
};

/// Counts the numbered lines, which ascend from 1; lines of other writers may stand between them.
int numberedLines(std::string const& text) {
    std::istringstream lines(text);
    int count = 0;
    for (std::string line; std::getline(lines, line);) {
        if (line.ends_with('\r')) line.pop_back();
        count += line == "line " + std::to_string(count + 1) ? 1 : 0;
    }
    return count;
}

} // namespace

TEST_F(ProcessEndOfLogs, has_every_line_in_its_file_after_a_normal_end) {
    struct Case {
        Row row;
        char const* how;
        int lines;
    };
    for (Case const& c : {
             Case{{}, "return", LINES},
             Case{{}, "open", LINES},
             Case{{}, "static", LINES + 1},
             Case{{}, "thread", LINES},
         }) {
        SCOPED_TRACE(c.row);
        std::filesystem::remove_all(root / "tmp");
        endBy(c.how);
        std::string const text = textOfAll();
        EXPECT_EQ(numberedLines(text), c.lines);
        EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), c.lines) << "each of them once";
    }
}

TEST_F(ProcessEndOfLogs, has_each_session_in_its_file) {
    endBy("session");
    EXPECT_EQ(numberedLines(textOfAll()), LINES);
    EXPECT_EQ(numberedLines(textOf(file(0))), 99);
    EXPECT_TRUE(isThere(LINES / 100));
    EXPECT_FALSE(isThere(LINES / 100 + 1));
}

TEST_F(ProcessEndOfLogs, has_the_lines_of_the_thread_that_ends_the_process_while_others_log) {
    for (int i = 0; i < 10; ++i) {
        std::filesystem::remove_all(root / "tmp");
        endBy("busy");
        EXPECT_EQ(numberedLines(textOfAll()), LINES);
    }
}

TEST_F(ProcessEndOfLogs, is_written_by_the_library_that_outlives_the_module_which_brought_it) {
    struct Case {
        Row row;
        char const* how;
    };
    for (Case const& c : {Case{{}, "closed"}, Case{{}, "kept"}}) {
        SCOPED_TRACE(c.how);
        std::filesystem::remove_all(root / "tmp");
        std::string const module = programBeside("unload_module");
        ChildResult const result = run({"unload_child", {module, c.how}, {{"XOS_ROOT", root.path()}}, root.path()});
        EXPECT_EQ(result.exitCode, 0);
        EXPECT_EQ(result.output, "alive\n");
        EXPECT_EQ(numberedLines(textOf(root / "tmp/zb_log/module/0.log")), 1);
    }
}

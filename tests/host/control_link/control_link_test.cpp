// Each module can be put in place of another of its name when the program is loaded.

#include "tests/host/control_link/answers.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

namespace {

/// Runs the child from a folder that holds the given modules; the others come from where they were built.
int runBeside(std::vector<std::string> const& modules) {
    namespace fs = std::filesystem;
    Scratch const scratch;
    for (std::string const& module : modules) {
        fs::path const stand = libraryFile(module);
        fs::copy_file(stand.parent_path() / "exchange" / stand.filename(), fs::path(scratch.path()) / stand.filename());
    }
    fs::path const program = programBeside("module_child");
    fs::path const child = fs::path(scratch.path()) / program.filename();
    fs::copy_file(program, child);
    std::string const built = fs::path(libraryFile("xos_basics")).parent_path().string();
    Child process{child.string(), {}, {{"LD_LIBRARY_PATH", scratch.path() + ":" + built}, {"PATH", built}}};
    return process.wait();
}

TEST(HostModules, can_be_exchanged_each_by_itself_and_all_together) {
    struct Case {
        Row row;
        std::vector<std::string> modules;
        int expected;
    };
    for (Case const& c :
         {Case{{}, {}, 0}, Case{{}, {"xos_basics"}, OTHER_BASICS}, Case{{}, {"xos_url"}, OTHER_URL},
          Case{{}, {"hq_basis"}, OTHER_ALERTS}, Case{{}, {"xos_basics", "xos_url"}, OTHER_BASICS + OTHER_URL},
          Case{{}, {"xos_basics", "xos_url", "hq_basis"}, OTHER_BASICS + OTHER_URL + OTHER_ALERTS}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(runBeside(c.modules), c.expected);
    }
}

} // namespace

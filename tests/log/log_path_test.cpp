#include "basis/log/log_path.h"

#include "tests/support/scratch_root.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

namespace fs = std::filesystem;
using namespace ZOR_Basis;

TEST(LogPath, lies_beneath_the_root) {
    std::string const logs = (scratchRoot() / "tmp/zb_log").generic_string();
    EXPECT_EQ(logFolder("job").c_str(), logs + "/job");
    EXPECT_EQ(logFolder("a/b c").c_str(), logs + "/a/b c");
    EXPECT_EQ(logFolder("").c_str(), logs);
}

TEST(LogPath, is_made_with_its_parents) {
    fs::remove_all(scratchRoot() / "tmp");
    logFolder("outer/inner");
    EXPECT_FALSE(fs::exists(scratchRoot() / "tmp")) << "asking for it makes nothing";
    for (int time = 0; time < 2; ++time) {
        EXPECT_EQ(makeLogFolder("outer/inner"), logFolder("outer/inner"));
        EXPECT_TRUE(fs::is_directory(scratchRoot() / "tmp/zb_log/outer/inner"));
    }
}

TEST(LogPath, of_a_session_is_its_number) {
    struct Case {
        Row row;
        std::uint64_t session;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, 0, "a/0.log"},
             Case{{}, 7, "a/7.log"},
             Case{{}, 10, "a/10.log"},
             Case{{}, 4'294'967'296, "a/4294967296.log"},
             Case{{}, ~std::uint64_t{0}, "a/18446744073709551615.log"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_STREQ(sessionFile(FPath("a"), c.session).c_str(), c.expected);
    }
}

#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

TEST(EntryNamesWin, that_differ_in_case_or_by_dots_at_their_end_are_one) {
    Tool tool;
    for (char const* folder : {"1", "2", "spool"}) makeFolder(tool / folder);
    put(tool / "1/file", "one");
    put(tool / "2/FILE", "two");
    Names const before = tool.content();
    for (char const* command : {"move", "copy"}) {
        for (char const* second : {"2/FILE", "2/file.", "2/File. "}) {
            SCOPED_TRACE(std::string(command) + " " + second);
            ToolResult const refused = tool.run({command, "--overwrite", "1/file", second, "spool"});
            EXPECT_EQ(refused.code, 2);
            EXPECT_TRUE(isOneLineAbout(refused.errors, "1/file, 2/")) << refused.errors;
            EXPECT_EQ(tool.content(), before);
        }
    }
}

} // namespace

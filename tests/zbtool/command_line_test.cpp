#include "tests/zbtool/tool.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

namespace {

TEST(CommandLine, refuses_what_it_does_not_know_in_one_line) {
    Tool tool;
    struct Case {
        Row row;
        std::vector<std::string> arguments;
        char const* about;
    };
    Case const cases[] = {
        {{}, {}, "command"},
        {{}, {"bogus"}, "bogus"},
        {{}, {"copy"}, "copy"},
        {{}, {"copy", "one"}, "copy"},
        {{}, {"copy", "--bogus", "a", "b"}, "--bogus"},
        {{}, {"find"}, "find"},
        {{}, {"--bogus"}, "--bogus"},
        {{}, {"count"}, "count"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        ToolResult const result = tool.run(c.arguments);
        EXPECT_EQ(result.code, 2);
        EXPECT_EQ(result.output, "");
        EXPECT_TRUE(isOneLineAbout(result.errors, c.about) ||
                    isOneLineAbout(result.errors, "zbtool: " + c.arguments[0]));
    }
}

TEST(CommandLine, helps_with_every_command) {
    Tool tool;
    std::string const commands = tool.run({"--help"}).output;
    for (char const* command :
         {"copy", "move", "delete", "count", "size", "find", "dict", "timers", "log", "crypt", "sys", "url"}) {
        SCOPED_TRACE(command);
        EXPECT_NE(commands.find(std::string("\n  ") + command + " "), std::string::npos) << commands;
        ToolResult const help = tool.run({command, "--help"});
        EXPECT_EQ(help.code, 0);
        EXPECT_NE(help.output.find(std::string("Usage: zbtool ") + command), std::string::npos) << help.output;
    }
}

} // namespace

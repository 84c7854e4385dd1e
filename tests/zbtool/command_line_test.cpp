#include "tests/zbtool/tool.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

namespace {

TEST(CommandLine, refuses_what_makes_no_sense_in_one_line_that_names_the_command) {
    Tool tool;
    put(tool / "file", "text");
    struct Case {
        Row row;
        std::vector<std::string> arguments;
        char const* command;
        char const* reason;
        char const* help;
    };
    Case const cases[] = {
        {{}, {}, "command", "is missing", ""},
        {{}, {"bogus"}, "command", "bogus does not exist", ""},
        {{}, {""}, "command", " does not exist", ""},
        {{}, {"--bogus"}, "command", "The following argument was not expected: --bogus", ""},
        {{}, {"copy"}, "copy", "SOURCE... TARGET is required", " copy"},
        {{}, {"copy", "one"}, "copy", "SOURCE... TARGET: At least 2 required but received 1", " copy"},
        {{}, {"copy", "--bogus", "a", "b"}, "copy", "The following argument was not expected: --bogus", " copy"},
        {{}, {"dict"}, "dict", "FILE is required", " dict"},
        {{}, {"dict", "d"}, "dict", "A subcommand is required", " dict"},
        {{}, {"dict", "d", "get"}, "dict get", "KEY is required", " dict FILE get"},
        {{},
         {"dict", "d", "check", "--hex"},
         "dict check",
         "The following argument was not expected: --hex",
         " dict FILE check"},
        {{}, {"url", "get", "x"}, "url get", "TARGET is required", " url get"},
        {{}, {"log", "x", "--session"}, "log", "--session: 1 required NUMBER missing", " log"},
        {{}, {"log", "x", "--session", "1x"}, "log", "Could not convert: --session = 1x", " log"},
        {{}, {"log", "x", "--session", "-1"}, "log", "Could not convert: --session = -1", " log"},
        // What is empty is not the same as what is missing.
        {{}, {"copy", "", "b"}, "copy", "SOURCE... TARGET: must not be empty", " copy"},
        {{}, {"count", ""}, "count", "PATH: must not be empty", " count"},
        {{}, {"find", "", "*"}, "find", "FOLDER: must not be empty", " find"},
        {{}, {"find", ".", ""}, "find", "WILDCARD: must not be empty", " find"},
        {{}, {"find", ".", "--name", ""}, "find", "--name: must not be empty", " find"},
        {{}, {"find", ".", "--ext", ""}, "find", "--ext: must not be empty", " find"},
        {{}, {"dict", "", "list"}, "dict list", "FILE: must not be empty", " dict FILE list"},
        {{}, {"dict", "d", "import", ""}, "dict import", "SOURCE: must not be empty", " dict FILE import"},
        {{}, {"timers", "file", "--sort", ""}, "timers", "--sort: must not be empty", " timers"},
        {{}, {"timers", "file", "--html", ""}, "timers", "--html: must not be empty", " timers"},
        {{}, {"log", ""}, "log", "NAME: must not be empty", " log"},
        {{}, {"log", "x", "--root", ""}, "log", "--root: must not be empty", " log"},
        {{},
         {"crypt", "encrypt", "file", "x", "--secret-file", ""},
         "crypt encrypt",
         "--secret-file: must not be empty",
         " crypt encrypt"},
        {{}, {"url", "get", "", "x"}, "url get", "URL: must not be empty", " url get"},
        {{}, {"url", "get", "x", "x", "--user", ""}, "url get", "--user: must not be empty", " url get"},
        // Options of which one makes the other senseless.
        {{}, {"find", ".", "--files", "--folders"}, "find", "--files excludes --folders", " find"},
        {{}, {"find", ".", "--any-case"}, "find", "--any-case requires WILDCARD", " find"},
        {{}, {"timers", "file", "--json", "--csv"}, "timers", "--json excludes --csv", " timers"},
        {{}, {"timers", "file", "--json", "--html", "x"}, "timers", "--json excludes --html", " timers"},
        {{}, {"timers", "file", "--html", "x", "--csv"}, "timers", "--csv excludes --html", " timers"},
        {{}, {"timers", "file", "--overwrite"}, "timers", "--overwrite requires --html", " timers"},
        {{}, {"timers", "file", "--compare"}, "timers", "--compare requires two reports or more", " timers"},
        {{},
         {"url", "get", "x", "x", "--password-file", "file"},
         "url get",
         "--password-file requires --user",
         " url get"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        std::string const help = std::string("; see zbtool") + c.help + " --help\n";
        EXPECT_EQ(tool.run(c.arguments),
                  (ToolResult{2, "", std::string("zbtool: ") + c.command + ": " + c.reason + help}));
        EXPECT_EQ(tool.content(), Names{"file"});
    }
}

TEST(CommandLine, tells_its_version) {
    Tool tool;
    EXPECT_EQ(tool.run({"--version"}), (ToolResult{0, "zbtool " ZBTOOL_VERSION "\n", ""}));
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

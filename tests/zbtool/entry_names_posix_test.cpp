#include "tests/zbtool/on_terminal_posix.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

namespace fs = std::filesystem;

namespace {

constexpr char WHY[] = "contains a backslash, which the library takes for a slash";

// "a\b" would be the entry "b" of the folder "a", and "a\" the folder itself.
TEST(EntryNamesPosix, refuse_a_path_that_the_library_takes_for_another) {
    Tool tool;
    makeFolder(tool / "a");
    makeFolder(tool / "a\\");
    makeFolder(tool / "spool");
    put(tool / "a/b", "1");
    put(tool / "a\\b", "2");
    Names const before = tool.content();
    struct Case {
        Row row;
        std::vector<std::string> arguments;
        char const* what;
    };
    Case const cases[] = {
        {{}, {"delete", "--yes", "a\\b"}, "delete: PATH"},
        {{}, {"delete", "--yes", "spool", "a\\"}, "delete: PATH"},
        {{}, {"move", "a\\b", "spool"}, "move: SOURCE... TARGET"},
        {{}, {"copy", "a\\", "spool"}, "copy: SOURCE... TARGET"},
        {{}, {"copy", "--overwrite", "spool", "a\\b"}, "copy: SOURCE... TARGET"},
        {{}, {"count", "a\\"}, "count: PATH"},
        {{}, {"find", "a\\"}, "find: FOLDER"},
        {{}, {"dict", "a\\b", "check"}, "dict check: FILE"},
        {{}, {"timers", "spool", "--html", "a\\c"}, "timers: --html"},
        {{}, {"crypt", "encrypt", "a/b", "a\\c", "--secret-file", "a/b"}, "crypt encrypt: TARGET"},
        {{}, {"url", "get", "file:///etc/hosts", "a\\c"}, "url get: TARGET"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        ToolResult const refused = tool.run(c.arguments);
        EXPECT_EQ(refused.code, 2);
        EXPECT_EQ(refused.errors.find(std::string("zbtool: ") + c.what + ": " + WHY), 0u) << refused.errors;
        EXPECT_EQ(tool.content(), before);
        EXPECT_EQ(textOf(tool / "a/b"), "1");
    }
}

/// "tree" with an entry "link\file", a link "link" to the folder "outside", and "outside/file".
void makeMisleadingTree(Tool const& tool) {
    makeFolder(tool / "outside");
    put(tool / "outside/file", "kept");
    makeFolder(tool / "tree");
    fs::create_symlink(tool / "outside", tool / "tree/link");
    put(tool / "tree/link\\file", "other");
}

TEST(EntryNamesPosix, never_lead_out_of_a_tree) {
    Tool tool;
    makeMisleadingTree(tool);
    std::string const complaint = std::string("zbtool: tree/link\\file: ") + WHY + "\n";
    ToolResult const counted = tool.run({"count", "tree"});
    EXPECT_EQ(counted, (ToolResult{1, "2\ttree\n", complaint}));
    EXPECT_EQ(tool.run({"find", "tree", "file"}), (ToolResult{1, "", complaint}));
    // Into a folder that is there it goes entry by entry.
    makeFolder(tool / "spool/tree");
    EXPECT_EQ(tool.run({"copy", "tree", "spool"}), (ToolResult{1, "", complaint}));
    EXPECT_FALSE(exists(tool / "spool/tree/link\\file"));
    // On a terminal it deletes entry by entry.
    ToolResult const kept = runOnTerminal(tool.path(), {"delete", "--yes", "tree"}, "");
    EXPECT_EQ(kept.code, 1);
    EXPECT_NE(kept.output.find(WHY), std::string::npos) << kept.output;
    EXPECT_EQ(textOf(tool / "outside/file"), "kept");
    EXPECT_EQ(textOf(tool / "tree/link\\file"), "other");
    // Elsewhere in one step, which takes names as they are.
    EXPECT_EQ(tool.run({"delete", "--yes", "tree"}).code, 0);
    EXPECT_EQ(tool.content(), (Names{"outside/", "outside/file", "spool/", "spool/tree/"}));
}

TEST(EntryNamesPosix, with_line_ends_leave_an_error_in_one_line) {
    Tool tool;
    EXPECT_EQ(tool.run({"count", "a\nb\x1b[2J"}).errors, "zbtool: a\\x0ab\\x1b[2J: No such file or directory\n");
    EXPECT_EQ(tool.run({"bogus\nword"}).errors, "zbtool: command: bogus\\x0aword does not exist; see zbtool --help\n");
}

TEST(EntryNamesPosix, do_not_steer_a_terminal) {
    Tool tool;
    makeFolder(tool / "job");
    put(tool / "job/a\x1b[2J\nb", "text");
    std::string const name = "job/a\x1b[2J\nb";
    std::string const shown = "job/a\\x1b[2J\\x0ab";
    EXPECT_EQ(tool.run({"find", "job"}).output, name + "\n") << "for other programs names stay as they are";
    EXPECT_EQ(tool.run({"size", name}).output, "4\t" + name + "\n");
    struct Case {
        Row row;
        std::vector<std::string> arguments;
        std::string expected;
    };
    Case const cases[] = {
        {{}, {"find", "job"}, shown + "\r\n"},
        {{}, {"size", name}, "4\t" + shown + "\r\n"},
        {{}, {"count", name}, "1\t" + shown + "\r\n"},
        {{}, {"count", "--kinds", name}, "0 others\t" + shown + "\r\n"},
        {{}, {"copy", name, "copy"}, "copied " + shown + " to copy\r\n"},
        {{}, {"move", "copy", name, "--overwrite"}, "moved copy to " + shown + "\r\n"},
        {{}, {"delete", name}, "delete " + shown + ": 1 entries, 4 bytes? [y/N] "},
        {{}, {"delete", "--yes", name}, "deleted " + shown + "\r\n"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        ToolResult const result = runOnTerminal(tool.path(), c.arguments, "n\n");
        EXPECT_NE(result.output.find(c.expected), std::string::npos) << result.output;
        EXPECT_EQ(result.output.find("\x1b[2J"), std::string::npos) << result.output;
    }
    EXPECT_EQ(tool.content(), Names{"job/"});
}

} // namespace

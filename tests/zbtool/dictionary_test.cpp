#include "tests/zbtool/tool.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

namespace {

/// The stored form of bytes.
std::string stored(std::string const& bytes) {
    return std::string{static_cast<char>(bytes.size()), '\0', '\0', '\0'} + bytes;
}

TEST(Dictionary, stores_and_prints_entries) {
    Tool tool;
    EXPECT_EQ(tool.run({"dict", "d", "set", "key", "value"}), (ToolResult{0, "", ""}));
    EXPECT_EQ(textOf(tool / "d"), stored("key") + stored("value"));
    EXPECT_EQ(tool.run({"dict", "d", "set", "a key", ""}).code, 0);
    EXPECT_EQ(tool.run({"dict", "d", "set", "key", "other"}).code, 0);
    EXPECT_EQ(tool.run({"dict", "d", "get", "key"}), (ToolResult{0, "other\n", ""}));
    EXPECT_EQ(tool.run({"dict", "d", "list"}), (ToolResult{0, "a key\t\nkey\tother\n", ""}));
    EXPECT_EQ(tool.run({"dict", "d", "list", "--hex"}).output, "61206b6579\t\n6b6579\t6f74686572\n");
    EXPECT_EQ(tool.run({"dict", "d", "list", "--json"}).output, "{\n  \"a key\": \"\",\n  \"key\": \"other\"\n}\n");
    EXPECT_EQ(tool.run({"dict", "d", "check"}).output, "d: whole, 2 entries, 29 bytes\n");
    EXPECT_EQ(tool.run({"dict", "d", "rm", "a key"}).code, 0);
    EXPECT_EQ(textOf(tool / "d"), stored("key") + stored("other"));
    EXPECT_EQ(tool.content(), Names{"d"});
}

TEST(Dictionary, exports_what_it_imports) {
    Tool tool;
    std::string const json = "{\n  \"caf\xC3\xA9\": \"a\\u0000b\\\\\",\n  \"key\": \"\\\"\"\n}\n";
    EXPECT_EQ(tool.run({"dict", "d", "import"}, json), (ToolResult{0, "", ""}));
    EXPECT_EQ(tool.run({"dict", "d", "get", "--hex", "636166c3a9"}).output, "6100625c\n");
    EXPECT_EQ(tool.run({"dict", "d", "export"}), (ToolResult{0, json, ""}));
    std::string const hex = tool.run({"dict", "d", "export", "--hex"}).output;
    put(tool / "hex", hex);
    EXPECT_EQ(tool.run({"dict", "other", "import", "--hex", "hex"}).code, 0);
    EXPECT_EQ(tool.run({"dict", "other", "export"}).output, json);
    EXPECT_EQ(tool.run({"dict", "other", "import", "--replace"}, "{\"new\": \"1\"}").code, 0);
    EXPECT_EQ(tool.run({"dict", "other", "list"}).output, "new\t1\n");
}

TEST(Dictionary, refuses_to_show_as_text_what_is_none) {
    Tool tool;
    EXPECT_EQ(tool.run({"dict", "d", "set", "--hex", "ff00", "80"}).code, 0);
    EXPECT_EQ(tool.run({"dict", "d", "list"}).output, "\\xff\\x00\t\\x80\n");
    ToolResult const refused = tool.run({"dict", "d", "export"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_EQ(refused.output, "");
    EXPECT_TRUE(isOneLineAbout(refused.errors, "d"));
    EXPECT_EQ(tool.run({"dict", "d", "export", "--hex"}).output, "{\n  \"ff00\": \"80\"\n}\n");
}

// Saving a file that is understood in part would cut it there.
TEST(Dictionary, changes_no_file_that_it_does_not_understand) {
    Tool tool;
    std::string const damaged = stored("key") + stored("value") + "\x09";
    std::vector<std::string> const commands[] = {{"set", "a", "b"}, {"rm", "key"}, {"import"}, {"list"}, {"check"}};
    for (std::vector<std::string> const& command : commands) {
        SCOPED_TRACE(command[0]);
        put(tool / "d", damaged);
        std::vector<std::string> arguments{"dict", "d"};
        arguments.insert(arguments.end(), command.begin(), command.end());
        ToolResult const refused = tool.run(arguments, "{}");
        EXPECT_EQ(refused.code, 1);
        EXPECT_TRUE(isOneLineAbout(refused.errors, "d"));
        EXPECT_NE(refused.errors.find("first 16 bytes"), std::string::npos) << refused.errors;
        EXPECT_EQ(textOf(tool / "d"), damaged);
    }
}

TEST(Dictionary, tells_what_is_missing_or_wrong) {
    Tool tool;
    put(tool / "d", stored("key") + stored("value"));
    struct Case {
        Row row;
        std::vector<std::string> arguments;
        char const* about;
        int code;
    };
    Case const cases[] = {
        {{}, {"gone", "list"}, "gone", 1},
        {{}, {"gone", "get", "key"}, "gone", 1},
        {{}, {"gone", "rm", "key"}, "gone", 1},
        {{}, {"gone", "check"}, "gone", 1},
        {{}, {"no/such/d", "set", "a", "b"}, "no/such/d", 1},
        {{}, {"d", "get", "other"}, "d", 1},
        {{}, {"d", "rm", "other"}, "d", 1},
        {{}, {"d", "set", "--hex", "zz", "00"}, "zz", 1},
        {{}, {"d", "import", "gone.json"}, "gone.json", 1},
        {{}, {"d", "import"}, "standard input", 1},
        {{}, {"d"}, "dict", 2},
        {{}, {"d", "bogus"}, "dict", 2},
        {{}, {"d", "get"}, "dict", 2},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        std::vector<std::string> arguments{"dict"};
        arguments.insert(arguments.end(), c.arguments.begin(), c.arguments.end());
        ToolResult const result = tool.run(arguments, "[]");
        EXPECT_EQ(result.code, c.code);
        EXPECT_TRUE(isOneLineAbout(result.errors, c.about));
        EXPECT_EQ(tool.content(), Names{"d"});
    }
}

} // namespace

#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

TEST(Secrets, decrypt_what_they_encrypt) {
    Tool tool;
    std::string const plain("not \0 only text\n", 16);
    put(tool / "plain", plain);
    put(tool / "secret", "swordfish\n");
    EXPECT_EQ(tool.run({"crypt", "encrypt", "plain", "hidden", "--secret-file", "secret"}), (ToolResult{0, "", ""}));
    EXPECT_EQ(textOf(tool / "hidden").size(), 24u);
    EXPECT_EQ(tool.run({"crypt", "decrypt", "hidden", "again", "--secret-file", "secret"}), (ToolResult{0, "", ""}));
    EXPECT_EQ(textOf(tool / "again"), plain);
    // The end of the line does not belong to the secret.
    put(tool / "bare", "swordfish");
    EXPECT_EQ(tool.run({"crypt", "encrypt", "plain", "same", "--secret-file", "bare"}).code, 0);
    EXPECT_EQ(textOf(tool / "same"), textOf(tool / "hidden"));
}

TEST(Secrets, agree_with_other_programs) {
    Tool tool;
    // RC2 of 128 bits in CBC mode, by the MD5 hash of "secret".
    put(tool / "plain", "message");
    put(tool / "secret", "secret");
    EXPECT_EQ(tool.run({"crypt", "encrypt", "plain", "hidden", "--secret-file", "secret"}).code, 0);
    EXPECT_EQ(textOf(tool / "hidden"), "\x82\xCA\x98\x4B\xF0\x57\x84\x94");
}

TEST(Secrets, spare_existing_files_unless_told_to_overwrite) {
    Tool tool;
    put(tool / "plain", "text");
    put(tool / "secret", "secret");
    put(tool / "hidden", "older");
    ToolResult const refused = tool.run({"crypt", "encrypt", "plain", "hidden", "--secret-file", "secret"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_TRUE(isOneLineAbout(refused.errors, "hidden"));
    EXPECT_EQ(textOf(tool / "hidden"), "older");
    EXPECT_EQ(tool.run({"crypt", "encrypt", "plain", "hidden", "--overwrite", "--secret-file", "secret"}).code, 0);
    EXPECT_EQ(textOf(tool / "hidden").size(), 8u);
    EXPECT_EQ(tool.content(), (Names{"hidden", "plain", "secret"}));
}

TEST(Secrets, never_overwrite_what_they_read) {
    Tool tool;
    put(tool / "plain", "text");
    put(tool / "secret", "secret");
    struct Case {
        char const* target;
        char const* reason;
    };
    Case const cases[] = {{"secret", "is the secret's file"},
                          {"./secret", "is the secret's file"},
                          {"plain", "is the file to read"},
                          {"./plain", "is the file to read"}};
    for (char const* command : {"encrypt", "decrypt"}) {
        for (Case const& c : cases) {
            SCOPED_TRACE(std::string(command) + " " + c.target);
            ToolResult const refused =
                tool.run({"crypt", command, "plain", c.target, "--secret-file", "secret", "--overwrite"});
            EXPECT_EQ(refused.code, 1);
            EXPECT_EQ(refused.errors, std::string("zbtool: ") + c.target + ": " + c.reason + "\n");
            EXPECT_EQ(textOf(tool / "plain"), "text");
            EXPECT_EQ(textOf(tool / "secret"), "secret");
        }
    }
}

TEST(Secrets, tell_what_is_missing_or_wrong) {
    Tool tool;
    put(tool / "plain", "text");
    put(tool / "secret", "secret");
    put(tool / "empty", "\n");
    put(tool / "broken", "1234567");
    struct Case {
        std::vector<std::string> arguments;
        char const* about;
        int code;
    };
    Case const cases[] = {
        {{"encrypt", "gone", "out", "--secret-file", "secret"}, "gone", 1},
        {{"encrypt", "plain", "out", "--secret-file", "gone"}, "gone", 1},
        {{"encrypt", "plain", "out", "--secret-file", "empty"}, "empty", 1},
        {{"decrypt", "broken", "out", "--secret-file", "secret"}, "broken", 1},
        {{"encrypt", "plain", "no/such/out", "--secret-file", "secret"}, "no/such/out", 1},
        {{"encrypt", "plain", "out"}, "secret", 2},
        {{"encrypt", "plain"}, "crypt", 2},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.about);
        std::vector<std::string> arguments{"crypt"};
        arguments.insert(arguments.end(), c.arguments.begin(), c.arguments.end());
        ToolResult const result = tool.run(arguments, "typed\n");
        EXPECT_EQ(result.code, c.code);
        EXPECT_TRUE(isOneLineAbout(result.errors, c.about));
        EXPECT_FALSE(exists(tool / "out"));
    }
}

} // namespace

#include "tests/zbtool/prepared_child_posix.h"
#include "tests/zbtool/tool.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <sstream>

namespace {

/// The first words of the entries in a section of a help text.
std::vector<std::string> entriesOf(std::string const& help, std::string const& section) {
    std::vector<std::string> entries;
    std::istringstream lines(help);
    bool isInside = false;
    for (std::string line; std::getline(lines, line);) {
        std::size_t const begin = line.starts_with("  -h,") ? 5 : 2;
        if (!line.starts_with("  "))
            isInside = line == section;
        else if (isInside && line.size() > begin && line[begin] != ' ')
            entries.push_back(line.substr(begin, line.find(' ', begin) - begin));
    }
    return entries;
}

/// A manual page as plain text.
std::string manualPage(std::string const& name) {
    std::string text = textOf(ZBTOOL.substr(0, ZBTOOL.rfind("/bin/")) + "/man/" + name + ".1");
    for (std::size_t at = 0; (at = text.find("\\-", at)) != std::string::npos;) text.erase(at, 1);
    return text;
}

TEST(CommandLinePosix, manual_pages_name_every_command_and_option) {
    Tool tool;
    std::string const help = tool.run({"--help"}).output;
    std::vector<std::string> const commands = entriesOf(help, "Subcommands:");
    EXPECT_EQ(commands.size(), 12u);
    for (std::string const& command : commands) {
        SCOPED_TRACE(command);
        EXPECT_NE(manualPage("zbtool").find(".B " + command + "\n"), std::string::npos);
        std::string const page = manualPage("zbtool-" + command);
        std::string const own = tool.run({command, "--help"}).output;
        std::vector<std::string> options = entriesOf(own, "Options:");
        for (std::string const& below : entriesOf(own, "Subcommands:")) {
            std::string const arguments = command == "dict" ? " FILE " : " ";
            EXPECT_NE(page.find(".SH zbtool " + command + arguments + below + "\n"), std::string::npos) << below;
            std::vector<std::string> words{command, below, "--help"};
            if (command == "dict") words.insert(words.begin() + 1, "FILE");
            std::vector<std::string> const more = entriesOf(tool.run(words).output, "Options:");
            options.insert(options.end(), more.begin(), more.end());
        }
        for (std::string const& option : options) EXPECT_NE(page.find(option), std::string::npos) << option;
        EXPECT_FALSE(options.empty());
    }
}

TEST(CommandLinePosix, is_completed_by_bash) {
    struct Case {
        Row row;
        char const* words;
        char const* expected;
    };
    Case const cases[] = {
        {{}, "zbtool ''", "copy move delete count size find dict timers log crypt sys url"},
        {{}, "zbtool co", "copy count"},
        {{}, "zbtool copy --", "--help --overwrite"},
        {{}, "zbtool copy ''", ""},
        {{}, "zbtool copy a --o", "--overwrite"},
        {{}, "zbtool dict ''", ""},
        {{}, "zbtool dict file ''", "list get set rm export import check"},
        {{}, "zbtool dict file import --", "--help --hex --replace"},
        {{}, "zbtool crypt e", "encrypt"},
        {{}, "zbtool url get --p", "--password-file"},
        {{}, "zbtool --", "--help --version"},
    };
    Tool tool;
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        std::string const script = "source '" ZBTOOL_COMPLETION "'; COMP_WORDS=(" + std::string(c.words) +
                                   "); COMP_CWORD=$((${#COMP_WORDS[@]} - 1)); _zbtool '" + ZBTOOL +
                                   "'; echo \"${COMPREPLY[*]}\"";
        auto const end = PreparedChild({"bash", "-c", script}, tool.path(), [] { return true; }).wait();
        EXPECT_EQ(end.output, std::string(c.expected) + "\n");
        EXPECT_EQ(end.errors, "");
    }
}

} // namespace

#include "tests/zbtool/tool.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <sstream>

namespace {

Names linesOf(std::string const& text) {
    Names lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);) lines.insert(line);
    return lines;
}

TEST(Find, prints_what_matches_all_that_is_asked_for) {
    Tool tool;
    makeFolder(tool / "job/Pages.d");
    put(tool / "job/ticket.JDF", "");
    put(tool / "job/Pages.d/page-1.pdl", "");
    put(tool / "job/Pages.d/page-2.PDL", "");
    put(tool / "job/Pages.d/pagexpdl", "");
    struct Case {
        Row row;
        std::vector<std::string> arguments;
        Names expected;
    };
    Case const cases[] = {
        {{},
         {},
         {"job/ticket.JDF", "job/Pages.d", "job/Pages.d/page-1.pdl", "job/Pages.d/page-2.PDL", "job/Pages.d/pagexpdl"}},
        {{}, {"*.pdl"}, {"job/Pages.d/page-1.pdl"}},
        {{}, {"*.pdl", "--any-case"}, {"job/Pages.d/page-1.pdl", "job/Pages.d/page-2.PDL"}},
        {{}, {"--ext", "pdl"}, {"job/Pages.d/page-1.pdl", "job/Pages.d/page-2.PDL"}},
        {{}, {"--ext", ".PDL"}, {"job/Pages.d/page-1.pdl", "job/Pages.d/page-2.PDL"}},
        {{}, {"--name", "TICKET.jdf"}, {"job/ticket.JDF"}},
        {{}, {"page-?.*", "--ext", "PDL"}, {"job/Pages.d/page-1.pdl", "job/Pages.d/page-2.PDL"}},
        {{}, {"--folders"}, {"job/Pages.d"}},
        {{}, {"--flat"}, {"job/ticket.JDF", "job/Pages.d"}},
        {{}, {"--flat", "--files"}, {"job/ticket.JDF"}},
        {{}, {"P*", "--files"}, {}},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        std::vector<std::string> arguments{"find", "job"};
        arguments.insert(arguments.end(), c.arguments.begin(), c.arguments.end());
        ToolResult const result = tool.run(arguments);
        EXPECT_EQ(linesOf(result.output), c.expected);
        EXPECT_EQ(result.code, c.expected.empty() ? 1 : 0);
        EXPECT_EQ(result.errors, "");
    }
    EXPECT_EQ(linesOf(tool.run({"find", "job", "page*", "--first"}).output).size(), 1u);
}

TEST(Find, tells_what_is_missing) {
    Tool tool;
    ToolResult const result = tool.run({"find", "gone", "*"});
    EXPECT_EQ(result.code, 1);
    EXPECT_TRUE(isOneLineAbout(result.errors, "gone"));
}

} // namespace

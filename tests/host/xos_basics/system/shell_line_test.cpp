#include "host/xos_basics/system/shell_line.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

TEST(HostShellLine, is_split_into_directory_and_command) {
    struct Case {
        Row row;
        char const* line;
        char const* directory;
        char const* command;
    };
    for (Case const& c : {
             Case{{}, "cd D:\\jobs& run.bat", "D:\\jobs", "run.bat"},
             Case{{}, "cd /srv/jobs& run", "/srv/jobs", "run"},
             Case{{}, "cd & run", "", "run"},
             Case{{}, "cd & ", "", ""},
             Case{{}, "cd /a& ", "/a", ""},
             Case{{}, "cd /a& b & c", "/a", "b & c"},
             Case{{}, "cd /a& b& c", "/a", "b& c"},
             Case{{}, "cd /R&D& run", "/R&D", "run"},
             Case{{}, "cd   /a b  & run", "/a b", "run"},
             Case{{}, "cd \"/a b\"& run", "/a b", "run"},
             Case{{}, "cd \"& run", "\"", "run"},
             Case{{}, "cd /a&run", "", "cd /a&run"},
             Case{{}, "cd /a", "", "cd /a"},
             Case{{}, "cd& run", "", "cd& run"},
             Case{{}, "CD /a& run", "", "CD /a& run"},
             Case{{}, " cd /a& run", "", " cd /a& run"},
             Case{{}, "echo cd /a& run", "", "echo cd /a& run"},
             Case{{}, "", "", ""},
         }) {
        SCOPED_TRACE(c.row);
        host::ShellLine const line = host::splitShellLine(c.line);
        EXPECT_EQ(line.directory, c.directory);
        EXPECT_EQ(line.command, c.command);
    }
}

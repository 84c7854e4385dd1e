#include "host/xos_basics/configuration/group_text.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

/// Each entry as "line:key=value", then the malformed lines as "line!".
std::string partsOf(std::string_view text) {
    host::GroupText const group = host::parseGroup(text);
    std::string parts;
    for (host::GroupEntry const& entry : group.entries) {
        parts += std::to_string(entry.line) + ":" + entry.key + "=" + entry.value + ";";
    }
    for (int const line : group.malformedLines) { parts += std::to_string(line) + "!"; }
    return parts;
}

TEST(HostGroupText, is_parsed_line_by_line) {
    struct Case {
        Row row;
        std::string_view text;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, "", ""},
             Case{{}, "\n \n\t\r\n", ""},
             Case{{}, "a=1", "1:a=1;"},
             Case{{}, " a b \t=  c d \r\n", "1:a b=c d;"},
             Case{{},
                  "\xEF\xBB\xBF"
                  "a=1",
                  "1:a=1;"},
             Case{{}, "a=1\nb=2\na=3\n", "1:a=1;2:b=2;3:a=3;"},
             Case{{}, "a=", "1:a=;"},
             Case{{}, "a=b=c", "1:a=b=c;"},
             Case{{}, "# a=1\n  # b=2\n", ""},
             Case{{}, "a=1 # one\nb=2#two\n", "1:a=1;2:b=2#two;"},
             Case{{}, "a\n=1\nb=2\n", "3:b=2;1!2!"},
             Case{{}, "a # = 1\n", "1!"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(partsOf(c.text), c.expected);
    }
}

TEST(HostGroupText, knows_the_words_of_a_switch) {
    struct Case {
        Row row;
        char const* word;
        std::optional<bool> expected;
    };
    for (Case const& c : {Case{{}, "true", true}, Case{{}, "YES", true}, Case{{}, "oN", true}, Case{{}, "1", true},
                          Case{{}, "false", false}, Case{{}, "No", false}, Case{{}, "OFF", false}, Case{{}, "0", false},
                          Case{{}, "", {}}, Case{{}, "tru", {}}, Case{{}, "trues", {}}, Case{{}, "2", {}},
                          Case{{}, "10", {}}, Case{{}, " on", {}}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(host::switchValue(c.word), c.expected);
    }
}

} // namespace

/// \file
/// Tables of test cases. A row begins with a `Row`, which remembers the line that it stands on.
///
///     struct Case { Row row; char const* input; bool expected; };
///     for (Case const& c : {Case{{}, "a", true}, Case{{}, "b", false}}) {
///         SCOPED_TRACE(c.row);
///         EXPECT_EQ(f(c.input), c.expected);
///     }

#ifndef TESTS_SUPPORT_TABLE_H
#define TESTS_SUPPORT_TABLE_H

#include <ostream>

struct Row {
    int line = __builtin_LINE();
};

inline std::ostream& operator<<(std::ostream& out, Row const& row) { return out << "row of line " << row.line; }

#endif

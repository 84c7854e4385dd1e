/// \file
/// Runs the program itself and gives all that it says.

#ifndef TESTS_ZBTOOL_TOOL_H
#define TESTS_ZBTOOL_TOOL_H

#include "tests/support/child.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <ostream>
#include <string>
#include <vector>

struct ToolResult {
    int code = -1;
    std::string output;
    std::string errors;

    bool operator==(ToolResult const&) const = default;
};

inline std::ostream& operator<<(std::ostream& out, ToolResult const& result) {
    return out << "exit code " << result.code << "\noutput: " << result.output << "\nerrors: " << result.errors;
}

/// A folder in which the program is run.
class Tool : public Scratch {
public:
    using Scratch::Scratch;

    /// \param input  is what standard input contains
    ToolResult run(std::vector<std::string> const& arguments, std::string const& input = "") const {
        Scratch const streams;
        put(streams / "input", input);
        Child child{"zbtool", arguments, environment, path(), streams / "input", streams / "errors"};
        ChildResult const result = ::run(child);
        return {result.exitCode, withoutReturns(result.output), withoutReturns(textOf(streams / "errors"))};
    }

    static std::string withoutReturns(std::string text) {
        text.erase(std::remove(text.begin(), text.end(), '\r'), text.end());
        return text;
    }

    std::vector<std::pair<std::string, std::string>> environment{{"XOS_ROOT", path()}};
};

/// Whether errors are one line that begins with the program's name and contains a text, and has more after it.
inline testing::AssertionResult isOneLineAbout(std::string const& errors, std::string const& text) {
    bool const isLine = std::count(errors.begin(), errors.end(), '\n') == 1 && errors.back() == '\n';
    std::size_t const place = errors.find(text);
    bool const hasReason = place != std::string::npos && errors.find(": ", place + text.size()) != std::string::npos;
    if (isLine && hasReason && errors.rfind("zbtool: ", 0) == 0) return testing::AssertionSuccess();
    return testing::AssertionFailure() << "not one line about " << text << ": " << errors;
}

#endif

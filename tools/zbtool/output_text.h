/// \file
/// What goes to standard output. Names and lines of others must not steer a terminal.

#ifndef TOOLS_ZBTOOL_OUTPUT_TEXT_H
#define TOOLS_ZBTOOL_OUTPUT_TEXT_H

#include <string>
#include <string_view>

namespace zbtool {

/// A name or a path as it is; on a terminal with its control characters by their numbers.
std::string shownName(std::string_view name);

/// Lines, whose ends and tabs stay on a terminal, too.
std::string shownLines(std::string_view lines);

} // namespace zbtool

#endif

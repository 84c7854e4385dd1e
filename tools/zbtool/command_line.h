/// \file
/// The command line: which commands there are, and what each accepts. Only its source includes the parser.

#ifndef TOOLS_ZBTOOL_COMMAND_LINE_H
#define TOOLS_ZBTOOL_COMMAND_LINE_H

namespace zbtool {

/// Runs the command that the arguments name.
/// \return the program's exit code
int run(int count, char** arguments);

} // namespace zbtool

#endif

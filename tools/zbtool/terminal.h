/// \file
/// What the program's streams are connected to. terminal_posix.cpp, terminal_win.cpp.

#ifndef TOOLS_ZBTOOL_TERMINAL_H
#define TOOLS_ZBTOOL_TERMINAL_H

#include <string>

namespace zbtool {

bool inputIsTerminal();
bool outputIsTerminal();
bool errorsAreTerminal();

/// Reads a line from the terminal without showing it. If a signal, on Windows Ctrl-C, ends the program meanwhile, the
/// terminal shows input again.
/// \param prompt  is printed on standard error
/// \return whether there was a line
bool readHidden(char const* prompt, std::string& line);

/// Passes bytes through standard input and output unchanged, which on Windows is a choice.
void useBinaryStreams();

} // namespace zbtool

#endif

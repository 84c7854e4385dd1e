// The sibling is terminal_win.cpp.

#include "tools/zbtool/terminal.h"

#include <cstdio>
#include <iostream>
#include <termios.h>
#include <unistd.h>

namespace zbtool {

bool inputIsTerminal() { return ::isatty(STDIN_FILENO) != 0; }
bool outputIsTerminal() { return ::isatty(STDOUT_FILENO) != 0; }
bool errorsAreTerminal() { return ::isatty(STDERR_FILENO) != 0; }

bool readHidden(char const* prompt, std::string& line) {
    std::fputs(prompt, stderr);
    termios shown{};
    ::tcgetattr(STDIN_FILENO, &shown);
    termios hidden = shown;
    hidden.c_lflag &= ~static_cast<tcflag_t>(ECHO);
    ::tcsetattr(STDIN_FILENO, TCSAFLUSH, &hidden);
    bool const good = static_cast<bool>(std::getline(std::cin, line));
    ::tcsetattr(STDIN_FILENO, TCSAFLUSH, &shown);
    std::fputc('\n', stderr);
    return good;
}

void useBinaryStreams() {}

} // namespace zbtool

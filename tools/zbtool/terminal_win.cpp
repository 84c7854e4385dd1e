// The sibling is terminal_posix.cpp.

#include "tools/zbtool/terminal.h"

#include <cstdio>
#include <fcntl.h>
#include <io.h>
#include <iostream>
#include <windows.h>

namespace zbtool {

bool inputIsTerminal() { return _isatty(_fileno(stdin)) != 0; }
bool outputIsTerminal() { return _isatty(_fileno(stdout)) != 0; }
bool errorsAreTerminal() { return _isatty(_fileno(stderr)) != 0; }

bool readHidden(char const* prompt, std::string& line) {
    std::fputs(prompt, stderr);
    HANDLE const input = GetStdHandle(STD_INPUT_HANDLE);
    DWORD shown = 0;
    GetConsoleMode(input, &shown);
    SetConsoleMode(input, shown & ~static_cast<DWORD>(ENABLE_ECHO_INPUT));
    bool const good = static_cast<bool>(std::getline(std::cin, line));
    SetConsoleMode(input, shown);
    std::fputc('\n', stderr);
    return good;
}

void useBinaryStreams() {
    _setmode(_fileno(stdin), _O_BINARY);
    _setmode(_fileno(stdout), _O_BINARY);
}

} // namespace zbtool

// The sibling is terminal_posix.cpp.

#include "tools/zbtool/terminal.h"

#include <cstdio>
#include <fcntl.h>
#include <io.h>
#include <iostream>
#include <windows.h>

namespace zbtool {
namespace {

DWORD shownInput = 0;

void show() { SetConsoleMode(GetStdHandle(STD_INPUT_HANDLE), shownInput); }

/// The next handler, which is the system's, then ends the program.
BOOL WINAPI showAndEnd(DWORD) {
    show();
    return FALSE;
}

} // namespace

bool inputIsTerminal() { return _isatty(_fileno(stdin)) != 0; }
bool outputIsTerminal() { return _isatty(_fileno(stdout)) != 0; }
bool errorsAreTerminal() { return _isatty(_fileno(stderr)) != 0; }

bool readHidden(char const* prompt, std::string& line) {
    std::fputs(prompt, stderr);
    HANDLE const input = GetStdHandle(STD_INPUT_HANDLE);
    GetConsoleMode(input, &shownInput);
    SetConsoleCtrlHandler(showAndEnd, TRUE);
    SetConsoleMode(input, shownInput & ~static_cast<DWORD>(ENABLE_ECHO_INPUT));
    bool const good = static_cast<bool>(std::getline(std::cin, line));
    show();
    SetConsoleCtrlHandler(showAndEnd, FALSE);
    std::fputc('\n', stderr);
    return good;
}

void useBinaryStreams() {
    _setmode(_fileno(stdin), _O_BINARY);
    _setmode(_fileno(stdout), _O_BINARY);
}

} // namespace zbtool

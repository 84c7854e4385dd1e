// The sibling is terminal_posix.cpp.

#include "examples/copy_job/terminal.h"

#include <cstdio>

#include <io.h>

bool outputIsTerminal() { return _isatty(_fileno(stdout)) != 0; }

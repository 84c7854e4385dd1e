// The sibling is terminal_win.cpp.

#include "examples/copy_job/terminal.h"

#include <unistd.h>

bool outputIsTerminal() { return isatty(STDOUT_FILENO) != 0; }

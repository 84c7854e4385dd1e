/// \file
/// Where the output goes.

#ifndef EXAMPLES_COPY_JOB_TERMINAL_H
#define EXAMPLES_COPY_JOB_TERMINAL_H

/// Whether the standard output is a terminal.
bool outputIsTerminal();

#endif

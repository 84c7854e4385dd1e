/// \file
/// What the program tells its caller.

#ifndef TOOLS_ZBTOOL_EXIT_CODE_H
#define TOOLS_ZBTOOL_EXIT_CODE_H

namespace zbtool {

enum ExitCode : int {
    DONE = 0,
    FAILED = 1, ///< something could not be done, or nothing was found
    MISUSED = 2 ///< the command line asks for something that does not exist or is not allowed
};

inline ExitCode exitCodeOf(bool good) { return good ? DONE : FAILED; }

} // namespace zbtool

#endif

/// \file
/// Ctrl-C: the program stops between two files, so that none is left half written. interruption_posix.cpp,
/// interruption_win.cpp.

#ifndef TOOLS_ZBTOOL_INTERRUPTION_H
#define TOOLS_ZBTOOL_INTERRUPTION_H

namespace zbtool {

/// From now on Ctrl-C, and on Linux the signals TERM and HUP, only make `isInterrupted` true. Call before threads are
/// started.
/// \param clear  removes what is half written. On Linux it runs, and the program ends, if the work has not stopped
///     within a second or at a second signal; on Windows, where no open file can be removed, the file that is being
///     written is finished, and a second Ctrl-C ends the program at once
void watchForInterruption(void (*clear)());

/// \thread thread-safe
bool isInterrupted();

/// Ends the program as the interruption would have ended it, so that a calling script stops, too.
[[noreturn]] void endAsInterrupted();

} // namespace zbtool

#endif

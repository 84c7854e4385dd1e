/// \file
/// Shows what the timers have found.

#ifndef EXAMPLES_COPY_JOB_TIMER_REPORT_H
#define EXAMPLES_COPY_JOB_TIMER_REPORT_H

#include <zor_basis/files.h>

/// Prints the report that lies beneath a root folder.
/// \return whether there is one
bool printTimerReport(ZOR_Basis::FPath const& root);

#endif

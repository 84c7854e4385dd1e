/// \file
/// Shows what the timers have found.

#ifndef EXAMPLES_COPY_JOB_TIMER_REPORT_H
#define EXAMPLES_COPY_JOB_TIMER_REPORT_H

#include <zor_basis/files.h>

/// Prints the report that lies beneath a root folder.
/// \param copy  names a file that receives the report, too; empty: none
/// \return whether there is one and it could be copied
bool printTimerReport(ZOR_Basis::FPath const& root, ZOR_Basis::FPath const& copy);

#endif

/// \file
/// A job as a print server receives it: pages, resources, a ticket.

#ifndef EXAMPLES_COPY_JOB_SAMPLE_JOB_H
#define EXAMPLES_COPY_JOB_SAMPLE_JOB_H

#include <zor_basis/files.h>

/// Makes a sample job: "job.ticket", a folder "pages" of 40 pages, and "resources" with fonts and images in folders of
/// their own. The same bytes each time.
/// \return whether everything is written
bool makeSampleJob(ZOR_Basis::FPath const& folder);

#endif

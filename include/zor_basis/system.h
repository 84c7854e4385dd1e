/// \file
/// What there is to know about the system that the component runs on, and what it is asked to do: other programs, folders
/// for jobs, URLs, and texts that come from such. Comes with the text types, in which it answers.

#ifndef ZOR_BASIS_SYSTEM_H
#define ZOR_BASIS_SYSTEM_H

#include "zor_basis/system/parse.h"
#include "zor_basis/system/process.h"
#include "zor_basis/system/sys.h"
#include "zor_basis/system/url.h"
#include "zor_basis/system/vdp_temp_dir.h"
#include "zor_basis/text.h"

#endif

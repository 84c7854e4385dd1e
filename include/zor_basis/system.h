/// \file
/// The system that the component runs on: users, drives, other programs, folders for jobs, URLs, and parsing texts.
/// Includes the text types, which the answers use.

#ifndef ZOR_BASIS_SYSTEM_H
#define ZOR_BASIS_SYSTEM_H

#include "zor_basis/system/parse.h"
#include "zor_basis/system/process.h"
#include "zor_basis/system/sys.h"
#include "zor_basis/system/url.h"
#include "zor_basis/system/vdp_temp_dir.h"
#include "zor_basis/text.h"

#endif

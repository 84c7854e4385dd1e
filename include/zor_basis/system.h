/// \file
/// What there is to know about the system that the component runs on.

#ifndef ZOR_BASIS_SYSTEM_H
#define ZOR_BASIS_SYSTEM_H

#include "zor_basis/system/sys.h"

#endif

/// \file
/// Memory managers.

#ifndef ZOR_BASIS_MEMORY_H
#define ZOR_BASIS_MEMORY_H

#include "zor_basis/memory/mem_mgr.h"

#endif

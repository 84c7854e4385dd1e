/// \file
/// The hash of texts and the integer helpers, under the path that users include.

#ifndef ZOR_BASIS_CONTAINERS_HASHING_H
#define ZOR_BASIS_CONTAINERS_HASHING_H

#include "zor_basis/ground/hashing.h"

#endif

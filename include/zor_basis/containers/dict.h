/// \file
/// `Dict`, under the path that users include.

#ifndef ZOR_BASIS_CONTAINERS_DICT_H
#define ZOR_BASIS_CONTAINERS_DICT_H

#include "zor_basis/store/dict.h"

#endif

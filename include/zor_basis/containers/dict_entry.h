/// \file
/// `DictEntry`, under the path that users include.

#ifndef ZOR_BASIS_CONTAINERS_DICT_ENTRY_H
#define ZOR_BASIS_CONTAINERS_DICT_ENTRY_H

#include "zor_basis/store/dict_entry.h"

#endif

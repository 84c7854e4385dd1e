/// \file
/// Lists, pointer arrays, the dictionary and its file, hashed texts, and the integer helpers that size their tables; and
/// the texts and bytes that they hold.

#ifndef ZOR_BASIS_CONTAINERS_H
#define ZOR_BASIS_CONTAINERS_H

#include "zor_basis/containers/hashed_str.h"
#include "zor_basis/containers/ptr_array.h"
#include "zor_basis/containers/sng_list.h"
#include "zor_basis/ground/hashing.h"
#include "zor_basis/store/dict.h"
#include "zor_basis/store/dict_entry.h"
#include "zor_basis/text.h"

#endif

/// \file
/// Lists, pointer arrays, the dictionary and its file, hashed texts, and integer functions for table sizes. Includes
/// the types of the texts and bytes that they contain.

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

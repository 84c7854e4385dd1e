/// \file
/// Walks over directory trees, what to do with the entries that they find, and searches.

#ifndef ZOR_BASIS_WALK_H
#define ZOR_BASIS_WALK_H

#include "zor_basis/walk/file_condition.h"
#include "zor_basis/walk/file_copy_visitor.h"
#include "zor_basis/walk/file_count_visitor.h"
#include "zor_basis/walk/file_delete_visitor.h"
#include "zor_basis/walk/file_iter_visitor.h"
#include "zor_basis/walk/file_iterator.h"
#include "zor_basis/walk/file_move_visitor.h"
#include "zor_basis/walk/file_size_visitor.h"
#include "zor_basis/walk/file_visitor.h"
#include "zor_basis/walk/find_file_visit.h"
#include "zor_basis/walk/link_or_copy.h"

#endif

/// \file
/// Walks over directory trees, visitors for the entries that they report, and searches.

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

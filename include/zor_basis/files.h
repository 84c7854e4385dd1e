/// \file
/// Paths, files, directories and their status. Includes the text types that name them.

#ifndef ZOR_BASIS_FILES_H
#define ZOR_BASIS_FILES_H

#include "zor_basis/files/dir.h"
#include "zor_basis/files/dir_iterator.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/files/file.h"
#include "zor_basis/files/file_entry.h"
#include "zor_basis/files/i_file.h"
#include "zor_basis/files/look_for_type.h"
#include "zor_basis/files/size.h"
#include "zor_basis/files/wc_path.h"
#include "zor_basis/text.h"

#endif

/// \file
/// Paths, files, directories and what there is to know about them; and the texts that they are named by.

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

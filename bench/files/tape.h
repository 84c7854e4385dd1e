/// \file
/// A file in memory that gives and takes the same bytes again and again; `seek` goes back to the first. It stands in a
/// source of its own, so that nobody's calls of it are made direct.

#ifndef BENCH_FILES_TAPE_H
#define BENCH_FILES_TAPE_H

#include <zor_basis/files/i_file.h>

#include <memory>

std::unique_ptr<ZOR_Basis::IFile> makeTape();

#endif

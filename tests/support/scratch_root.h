/// \file
/// A root folder for the whole test program, empty at its start and removed at its end.

#ifndef TESTS_SUPPORT_SCRATCH_ROOT_H
#define TESTS_SUPPORT_SCRATCH_ROOT_H

#include <filesystem>

std::filesystem::path const& scratchRoot();

#endif

/// \file
/// The system calls that replace a file: replacement_win.cpp, replacement_posix.cpp.

#ifndef BASIS_FILES_REPLACEMENT_IMPL_H
#define BASIS_FILES_REPLACEMENT_IMPL_H

#include "zor_basis/files/f_path.h"

#include <cstdint>

namespace ZOR_Basis {

/// Follows symbolic links to the path of the file itself.
/// \param target  receives it; the path itself if it is not a link or nothing exists there
/// \error the path is empty, or its links cannot be followed
bool followLinks(char const* path, FPath& target);

enum class Made { YES, NAME_TAKEN, FAILED };

/// Makes an empty file under an unused name, with the owner and the permissions of the target if there is one,
/// as far as the system allows.
/// \return FAILED also if the target may not be written or is not a file
Made makeBeside(char const* temporary, char const* target);

/// Whether a name may begin behind this character of a path.
bool endsFolder(char c);

std::uint64_t processNumber();

/// Cuts a path behind the folder that its last name lies in; nothing is left of a bare name.
inline void cutToFolder(FPath& path) {
    std::uint64_t n = path.size();
    while (n != 0 && !endsFolder(path.c_str()[n - 1])) --n;
    path.getBuf()[n] = '\0';
    path.resize();
}

} // namespace ZOR_Basis

#endif

#include "zor_basis/files/i_file.h"

namespace ZOR_Basis {

IFile::~IFile() = default;

std::uint64_t IFile::getline(char*, std::uint64_t) { return 0; }

} // namespace ZOR_Basis

#include "zor_basis/walk/file_condition.h"

namespace ZOR_Basis {

FileCondition::~FileCondition() = default;

bool FileCondition::acceptName(FileIterator* /*it*/, char const* /*name*/) { return true; }

bool FileCondition::acceptEntry(FileEntry* /*entry*/) { return true; }

} // namespace ZOR_Basis

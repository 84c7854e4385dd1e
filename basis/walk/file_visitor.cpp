#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

FileVisitor::~FileVisitor() = default;

bool FileVisitor::stop() { return false; }

} // namespace ZOR_Basis

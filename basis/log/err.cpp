#include "zor_basis/log/err.h"

namespace ZOR_Basis {

void Err::err(char const*) {}
void Err::trace(char const*) {}

} // namespace ZOR_Basis

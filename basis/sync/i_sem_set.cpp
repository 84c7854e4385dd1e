#include "zor_basis/sync/i_sem_set.h"

namespace ZOR_Basis {

ISemSet::~ISemSet() = default;

} // namespace ZOR_Basis

#include "zor_basis/containers/hashed_str.h"

namespace ZOR_Basis {

ZB_INSTANTIATE_TEMPLATE HashedStr<HeapStr>;

} // namespace ZOR_Basis

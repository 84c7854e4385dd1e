// The sibling is domain_cache_win.cpp.

#include "zor_basis/system/sys.h"

namespace ZOR_Basis {

bool Sys::FullDomain(Str const&, BufStr<255>&) { return false; }

bool Sys::ShortDomain(Str const&, BufStr<255>&) { return false; }

} // namespace ZOR_Basis

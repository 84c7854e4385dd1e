// The sibling is domain_cache_win.cpp.

#include "zor_basis/system/sys.h"

#include "basis/files/last_error.h"

namespace ZOR_Basis {

bool Sys::FullDomain(Str const&, BufStr<255>&) { return refuse(Reason::NOT_SUPPORTED); }

bool Sys::ShortDomain(Str const&, BufStr<255>&) { return refuse(Reason::NOT_SUPPORTED); }

} // namespace ZOR_Basis

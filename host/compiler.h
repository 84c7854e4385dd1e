/// \file
/// The compiler's words under names of the host.

#ifndef HOST_COMPILER_H
#define HOST_COMPILER_H

/// `HOST_INLINE`: into every caller, also at low optimisation. `HOST_COLD`: seldom called, so its callers are laid out
/// as if it were never called.
#if defined(__GNUC__)
#define HOST_INLINE [[gnu::always_inline]] inline
#define HOST_COLD [[gnu::noinline, gnu::cold]]
#else
#define HOST_INLINE inline
#define HOST_COLD
#endif

#endif

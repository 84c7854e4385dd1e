/// \file
/// The compiler's words under names of the host.

#ifndef HOST_COMPILER_H
#define HOST_COMPILER_H

/// `HOST_INLINE`: into every caller, also at low optimisation.
#if defined(__GNUC__)
#define HOST_INLINE [[gnu::always_inline]] inline
#else
#define HOST_INLINE inline
#endif

#endif

/// \file
/// The compiler's words under one name each: inlining, targets, tests of the processor, sanitizers. They are for the
/// library's own headers.
///
/// A function that carries a target runs only where the test of the same name holds; it may inline plain functions,
/// while plain functions cannot inline it.

#ifndef ZOR_BASIS_GROUND_COMPILER_H
#define ZOR_BASIS_GROUND_COMPILER_H

#include "zor_basis/export.h"

/// 1 where a sanitizer checks the address of every byte that is read.
#if defined(__SANITIZE_ADDRESS__)
#define ZB_ADDRESS_SANITIZER 1
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define ZB_ADDRESS_SANITIZER 1
#endif
#endif
#if !defined(ZB_ADDRESS_SANITIZER)
#define ZB_ADDRESS_SANITIZER 0
#endif

/// 1 where vectors of 16 bytes (SSE2) can be used without a test.
#if defined(__SSE2__) || defined(_M_X64)
#define ZB_VECTORS 1
#else
#define ZB_VECTORS 0
#endif

/// `ZB_INLINE`: into every caller, also at low optimisation. `ZB_COLD`: never into a caller. `ZB_HIDE(pointer)`: from
/// here on the compiler does not know what the pointer points to; only where `ZB_CAN_HIDE` is 1. `ZB_ONE_LOAD(vector)`:
/// the compiler keeps what it has loaded, and does not load it again for each use.
#if defined(__GNUC__)
#define ZB_INLINE [[gnu::always_inline]] inline
#define ZB_COLD [[gnu::noinline]]
#define ZB_CAN_HIDE 1
#define ZB_HIDE(pointer) __asm__("" : "+r"(pointer))
#define ZB_ONE_LOAD(vector) __asm__("" : "+x"(vector))
#else
#define ZB_INLINE inline
#define ZB_COLD
#define ZB_CAN_HIDE 0
#define ZB_ONE_LOAD(vector)
#endif

/// Before a variable of the library that other files of it use: it lies at a known distance from their code.
#if defined(__ELF__)
#define ZB_HIDDEN [[gnu::visibility("hidden")]]
#else
#define ZB_HIDDEN
#endif

/// Before a function that reads on purpose what no object owns.
#if defined(__GNUC__)
#define ZB_UNSANITIZED [[gnu::no_sanitize_address]]
#else
#define ZB_UNSANITIZED
#endif

/// Targets, and whether the processor has them.
#if (defined(__GNUC__) || defined(__clang__)) && ZB_VECTORS
#define ZB_SSSE3 [[gnu::target("ssse3")]]
#define ZB_AVX2 [[gnu::target("avx2")]]
#else
#define ZB_SSSE3
#define ZB_AVX2
#endif
#if defined(__GNUC__) && ZB_VECTORS
#define ZB_HAS_SSSE3 (__builtin_cpu_supports("ssse3") != 0)
#define ZB_HAS_AVX2 (__builtin_cpu_supports("avx2") != 0)
#else
#define ZB_HAS_SSSE3 false
#define ZB_HAS_AVX2 false
#endif

#endif

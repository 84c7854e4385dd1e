// Microsoft's runtime has these as functions in C++, which libc++ relies on; mingw-w64 has macros.
#ifndef ZB_LINT_MATH_H
#define ZB_LINT_MATH_H

#include_next <math.h>

#ifdef __cplusplus
#undef fpclassify
#undef isfinite
#undef isinf
#undef isnan
#undef isnormal
#undef signbit

extern "C++" {
#define ZB_LINT_CLASS_OF(Number)                                                                                       \
    int fpclassify(Number) noexcept;                                                                                   \
    bool isfinite(Number) noexcept;                                                                                    \
    bool isinf(Number) noexcept;                                                                                       \
    bool isnan(Number) noexcept;                                                                                       \
    bool isnormal(Number) noexcept;                                                                                    \
    bool signbit(Number) noexcept;
ZB_LINT_CLASS_OF(float)
ZB_LINT_CLASS_OF(double)
ZB_LINT_CLASS_OF(long double)
#undef ZB_LINT_CLASS_OF
}
#endif

#endif

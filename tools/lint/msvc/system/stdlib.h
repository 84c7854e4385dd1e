// Two functions of Microsoft's runtime that mingw-w64 does not declare and libc++ calls.
#ifndef ZB_LINT_STDLIB_H
#define ZB_LINT_STDLIB_H

#include_next <stdlib.h>

#ifdef __cplusplus
extern "C" float __cdecl _strtof_l(char const*, char**, _locale_t);
extern "C" long double __cdecl _strtold_l(char const*, char**, _locale_t);
#endif

#endif

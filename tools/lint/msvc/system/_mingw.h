// The first header that every other one of mingw-w64 includes. It defines attributes for GNU compilers only, so it is
// told that this is one; after it, nobody is.
#ifndef ZB_LINT_MINGW_H
#define ZB_LINT_MINGW_H

#define _UCRT
#define __GNUC__ 4
#define __GNUC_MINOR__ 2
#include_next <_mingw.h>
#undef __GNUC__
#undef __GNUC_MINOR__

#define _SSIZE_T_DEFINED

#endif

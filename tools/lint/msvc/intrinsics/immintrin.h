// Clang's header reads all vector instructions, half a second each time. These are what the library uses.
#ifndef __IMMINTRIN_H
#define __IMMINTRIN_H

#include <smmintrin.h>

#include <avxintrin.h>

#include <avx2intrin.h>

#include <avx512fintrin.h>

#include <avx512bwintrin.h>

#endif

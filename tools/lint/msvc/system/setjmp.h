// The one type that clang's intrin.h takes from here.
#pragma once
typedef long long jmp_buf[32];

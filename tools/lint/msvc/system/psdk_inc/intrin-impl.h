// mingw-w64 writes the compiler's intrinsic functions in GNU assembly. Clang has them.
#include <intrin.h>

// Clang's header reads all vector instructions, half a second each time. windows.h needs none beyond SSE2.
#include <emmintrin.h>

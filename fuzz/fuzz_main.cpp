// Hands the inputs that libFuzzer makes to the one target of the program.

#include "fuzz/target.h"

extern "C" int LLVMFuzzerTestOneInput(unsigned char const* data, std::size_t size) {
    FuzzTarget::all().front()->run(data, size);
    return 0;
}

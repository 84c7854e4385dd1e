#include "zor_basis/flat.h"

#include <cstdlib>
#include <cstring>

char* ZB_StrDup(char const* text) {
    if (text == nullptr) return nullptr;
    std::size_t const bytes = std::strlen(text) + 1;
    void* copy = std::malloc(bytes);
    return copy != nullptr ? static_cast<char*>(std::memcpy(copy, text, bytes)) : nullptr;
}

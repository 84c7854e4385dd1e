#include "zor_basis/containers/hashing.h"

namespace ZOR_Basis {

std::uint64_t hashDjb2(char const* text, std::uint64_t) noexcept {
    std::uint64_t hash = 5381;
    if (text == nullptr) return hash;
    for (; *text != '\0'; ++text) {
        // kept hash-01: the sign of the byte takes part, whatever the compiler's char is
        auto const signedByte = static_cast<std::int64_t>(static_cast<signed char>(*text));
        hash = hash * 33 + static_cast<std::uint64_t>(signedByte);
    }
    return hash;
}

} // namespace ZOR_Basis

/// \file
/// `LookForType`: selects the entries that a listing or a walk reports.

#ifndef ZOR_BASIS_FILES_LOOK_FOR_TYPE_H
#define ZOR_BASIS_FILES_LOOK_FOR_TYPE_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

/// What to report; the kinds are in the low two bits.
enum LookForType : std::uint32_t {
    LOOK_ALL = 0,
    LOOK_FILES = 1,
    LOOK_DIRS = 2,
    LOOK_BOTH = 3,    ///< in a listing the same as `LOOK_ALL`, which a walk takes for `LOOK_DIRS`
    LOOK_ANYCASE = 4, ///< may be added: the wildcard ignores case, in listings that support this
};

/// Combine selections.
constexpr LookForType operator|(LookForType a, LookForType b) {
    return static_cast<LookForType>(static_cast<std::uint32_t>(a) | static_cast<std::uint32_t>(b));
}
constexpr LookForType operator&(LookForType a, LookForType b) {
    return static_cast<LookForType>(static_cast<std::uint32_t>(a) & static_cast<std::uint32_t>(b));
}
constexpr LookForType& operator|=(LookForType& a, LookForType b) { return a = a | b; }

} // namespace ZOR_Basis

#endif

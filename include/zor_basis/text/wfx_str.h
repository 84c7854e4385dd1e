/// \file
/// `WFxStr`: a view of wide text owned elsewhere that can be set to another text. It never copies text.

#ifndef ZOR_BASIS_TEXT_WFX_STR_H
#define ZOR_BASIS_TEXT_WFX_STR_H

#include "zor_basis/text/wstr.h"

#include <cstdint>
#include <functional>

namespace ZOR_Basis {

class ZB_API WFxStr : public WStr {
public:
    /// Views the shared empty text.
    WFxStr() noexcept = default;
    /// Views a text of n units; measures the text if n is 0. Null views the shared empty text.
    WFxStr(WChar const* text, std::uint64_t n = 0) noexcept {
        if (text != nullptr) set(text, n != 0 ? n : Len(text));
    }

    /// Views a zero-terminated text and measures it.
    /// \pre not null
    WFxStr& set(WChar const* text) noexcept { return set(text, Len(text)); }
    /// Stores both words as given; nothing is measured.
    WFxStr& set(WChar const* text, std::uint64_t n) noexcept {
        text_ = text;
        size_ = n;
        return *this;
    }
    /// Views the shared empty text.
    WFxStr& clear() noexcept { return set(StrEmpty, 0); }
    /// Tells whether the view points at exactly this text.
    /// \kept wide-02: the function compares addresses, never texts
    bool equal(WChar const* text) const noexcept {
        // kept wide-02: callers use this to learn whether their buffer has moved
        return text_ == text;
    }
};

static_assert(sizeof(WFxStr) == sizeof(WStr));

} // namespace ZOR_Basis

template <>
struct std::hash<ZOR_Basis::WFxStr> : std::hash<ZOR_Basis::WStr> {};

#endif

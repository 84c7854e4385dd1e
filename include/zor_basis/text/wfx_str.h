/// \file
/// `WFxStr`: a view of wide text owned elsewhere that can be pointed at another text. Never copies.

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
    /// Views a text of n units, or measures it where n is 0; null views the shared empty text.
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
    /// Whether this is the very text that is viewed.
    /// \kept wide-02: addresses are compared, never texts
    bool equal(WChar const* text) const noexcept {
        // kept wide-02: callers ask whether they have to follow a moved buffer
        return text_ == text;
    }
};

static_assert(sizeof(WFxStr) == sizeof(WStr));

} // namespace ZOR_Basis

template <>
struct std::hash<ZOR_Basis::WFxStr> : std::hash<ZOR_Basis::WStr> {};

#endif

#include "zor_basis/text/wstr.h"

#include <cwctype>

namespace ZOR_Basis {

constinit WChar const* const WStr::StrEmpty = ZB_W("");

namespace {

/// A unit whose other case needs more than one unit does not change.
template <class Function>
void changeUnits(WChar* text, Function change) noexcept {
    for (; *text != WChar(); ++text) {
        auto const changed = static_cast<std::uint64_t>(change(static_cast<std::wint_t>(*text)));
        if (changed <= 0xFFFF) *text = static_cast<WChar>(changed);
    }
}

} // namespace

void WStr::toLower(WChar* text) noexcept {
    changeUnits(text, [](std::wint_t unit) { return std::towlower(unit); });
}

void WStr::toUpper(WChar* text) noexcept {
    changeUnits(text, [](std::wint_t unit) { return std::towupper(unit); });
}

} // namespace ZOR_Basis

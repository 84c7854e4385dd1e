#include "zor_basis/text/wb_str.h"

#include "basis/text/inline_text_impl.h"

#include <cstdlib>

namespace ZOR_Basis {

WChar* WBStr::alloc(std::uint64_t count) { return static_cast<WChar*>(std::calloc(count, SizeWChar)); }

void WBStr::free() { std::free(getBuf()); }

WBStr& WBStr::toLower(WChar const* text, std::uint64_t n) {
    return assignChanged(text, n, [](WChar* units) { WStr::toLower(units); });
}

WBStr& WBStr::toUpper(WChar const* text, std::uint64_t n) {
    return assignChanged(text, n, [](WChar* units) { WStr::toUpper(units); });
}

WBStr& WBStr::assignChanged(WChar const* text, std::uint64_t n, Change change) {
    if (text == nullptr) {
        clear();
        return *this;
    }
    // kept wide-03: the block has room for the text and its terminator and no more
    Text::assignExactly(*this, text, n != 0 ? n : Len(text));
    change(getBuf());
    return *this;
}

ZB_INSTANTIATE_TEMPLATE detail::InlineText<WBStr, WChar, 255>;

} // namespace ZOR_Basis

#include "zor_basis/text/buf_str.h"

#include "basis/text/inline_text_impl.h"

#include <charconv>

namespace ZOR_Basis {

namespace {

template <class String, class Number>
String& addDigits(String& text, Number number) {
    char digits[24];
    *std::to_chars(digits, digits + sizeof digits - 1, number).ptr = '\0';
    return text.add(digits);
}

} // namespace

template <std::uint64_t N>
requires(N == 15 || N == 255) BufStr<N>
&BufStr<N>::addNumber(std::int64_t number) { return addDigits(*this, number); }

template <std::uint64_t N>
requires(N == 15 || N == 255) BufStr<N>
&BufStr<N>::addNumber(std::uint64_t number) { return addDigits(*this, number); }

template <std::uint64_t N>
requires(N == 15 || N == 255) BufStr<N>
&BufStr<N>::toHex(char const* text) {
    std::uint64_t const length = detail::sourceLength(text, 0);
    detail::HeldText<char> const held(text, Text::holds(*this, text) ? length : 0);
    clear();
    if (length == 0) return *this;
    CopyIfTooLong(text_, detail::plus(length, length), 0);
    char const* source = held.orElse(text);
    for (std::uint64_t i = 0; i < length; ++i) ch2hex(source[i], getBuf() + 2 * i);
    Text::setSize(*this, 2 * length);
    return *this;
}

template <std::uint64_t N>
requires(N == 15 || N == 255) BufStr<N>
&BufStr<N>::fromHex(char const* digits) {
    std::uint64_t const length = detail::sourceLength(digits, 0);
    detail::HeldText<char> const held(digits, Text::holds(*this, digits) ? length : 0);
    char const* pair = held.orElse(digits);
    // kept text-11: appending the byte 0 appends nothing, so no text ends in the middle
    for (char const* end = pair + (length & ~std::uint64_t{1}); pair != end; pair += 2) add(decodeHexChar(pair));
    return *this;
}

ZB_INSTANTIATE_TEMPLATE detail::InlineText<BufStr<15>, char, 15>;
ZB_INSTANTIATE_TEMPLATE BufStr<15>;
ZB_INSTANTIATE_TEMPLATE detail::InlineText<BufStr<255>, char, 255>;
ZB_INSTANTIATE_TEMPLATE BufStr<255>;

} // namespace ZOR_Basis

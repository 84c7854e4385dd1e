/// \file
/// Compares the strings that own their text with a `std::string_view`. Not meant for users.
///
/// A view compares like a `std::string` with the same bytes; nothing behind its end is read. A view of a part of a text
/// therefore never equals the whole text, even if both begin at the same address.

#ifndef ZOR_BASIS_TEXT_VIEW_OPS_H
#define ZOR_BASIS_TEXT_VIEW_OPS_H

#include "zor_basis/text/str.h"
#include "zor_basis/text/word_ops.h"

#include <concepts>
#include <string_view>

namespace ZOR_Basis::detail {

/// `std::string_view` itself, not a type that merely converts to it.
template <class T>
concept StringView = std::same_as<T, std::string_view>;

/// The order of the texts up to their terminators: less than 0, 0 or greater than 0.
inline int compareWithView(char const* text, std::string_view view) noexcept {
    std::uint64_t const length = textLengthUpTo(view.data(), view.size());
    int const order = compareTextsUpTo(text, view.data(), length);
    return order != 0 ? order : static_cast<unsigned char>(text[length]);
}

/// Equality with the view on the right, and on the left, by text-01.
inline bool sameAsView(Str const& text, std::string_view view) noexcept {
    if (view.empty()) return text.first() == '\0';
    return text.size() == view.size() && sameOwnedTexts(text.c_str(), view.data(), view.size());
}
inline bool viewSameAs(std::string_view view, Str const& text) noexcept {
    if (text.empty()) return compareWithView(text.c_str(), view) == 0;
    return text.size() == view.size() && sameOwnedTexts(view.data(), text.c_str(), view.size());
}

} // namespace ZOR_Basis::detail

#endif

/// \file
/// The strings with an inside area under common names, so that one suite runs over all of them.

#ifndef TESTS_TEXT_STRING_KINDS_H
#define TESTS_TEXT_STRING_KINDS_H

#include "zor_basis/text.h"

#include <string>
#include <vector>

template <class String>
struct Kind;

template <std::uint64_t N>
struct Kind<ZOR_Basis::BufStr<N>> {
    using Char = char;
    using View = ZOR_Basis::Str;
    static constexpr std::uint64_t INSIDE = N;
};

template <>
struct Kind<ZOR_Basis::WBStr> {
    using Char = ZOR_Basis::WChar;
    using View = ZOR_Basis::WStr;
    static constexpr std::uint64_t INSIDE = 255;
};

template <class String>
using CharOf = typename Kind<String>::Char;
template <class String>
using ViewOf = typename Kind<String>::View;
template <class String>
using TextOf = std::basic_string<CharOf<String>>;

/// ASCII text in the characters of a kind, inner zeros included.
template <class String>
TextOf<String> make(std::string_view ascii) {
    return {ascii.begin(), ascii.end()};
}

/// Exactly the bytes that a string holds, its terminator excluded.
template <class String>
TextOf<String> contentOf(String const& s) {
    typename Kind<String>::Char const* text = s;
    return {text, s.size()};
}

template <class String>
bool isInside(String const& s) {
    auto const* text = reinterpret_cast<char const*>(static_cast<typename Kind<String>::Char const*>(s));
    auto const* object = reinterpret_cast<char const*>(&s);
    return text >= object && text < object + sizeof s;
}

template <class String>
bool isTerminated(String const& s) {
    return static_cast<typename Kind<String>::Char const*>(s)[s.size()] == 0;
}

/// A text in its own block, which ends with the terminator, so that a sanitizer sees every read beyond it.
template <class Char>
struct Exact {
    explicit Exact(std::basic_string<Char> const& text) : units(text.begin(), text.end()) { units.push_back(0); }
    operator Char const*() const { return units.data(); }
    std::vector<Char> units;
};

#endif

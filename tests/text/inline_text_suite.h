/// \file
/// The fixture of the suites for strings with an inside area.

#ifndef TESTS_TEXT_INLINE_TEXT_SUITE_H
#define TESTS_TEXT_INLINE_TEXT_SUITE_H

#include "tests/text/string_kinds.h"

#include <gtest/gtest.h>

#include <string>
#include <type_traits>

template <class String>
class InlineTextSuite : public testing::Test {
public:
    static TextOf<String> letters(std::uint64_t n) {
        TextOf<String> text;
        for (std::uint64_t i = 0; i < n; ++i) text += static_cast<typename Kind<String>::Char>('a' + i % 26);
        return text;
    }
    static String appended(std::uint64_t n) {
        String s;
        for (auto c : letters(n)) s += c;
        return s;
    }
    static String onHeap(TextOf<String> const& text) {
        String s;
        s.extendBuf(Kind<String>::INSIDE + 1);
        s.copy(text.c_str());
        return s;
    }
};

using InlineTextKinds = testing::Types<ZOR_Basis::BufStr<15>, ZOR_Basis::BufStr<255>, ZOR_Basis::WBStr>;

struct InlineTextNames {
    template <class String>
    static std::string GetName(int) {
        if (std::is_same_v<String, ZOR_Basis::WBStr>) return "WBStr";
        return "BufStr" + std::to_string(Kind<String>::INSIDE);
    }
};

#endif

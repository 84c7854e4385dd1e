#include "tests/text/random_utf.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

std::uint64_t plainLength(reference::WideText const& text) {
    return reference::utf8(reference::characters(text)).size();
}

std::uint64_t lengthOf(reference::WideText const& text) { return Utf::utf8Length(text.data(), text.size()); }

} // namespace

TEST(Utf8Length, counts_each_kind_of_character) {
    EXPECT_EQ(lengthOf({}), 0u);
    EXPECT_EQ(lengthOf({0}), 1u);
    EXPECT_EQ(lengthOf({0x7F, 0x80, 0x7FF, 0x800, 0xFFFF}), 1u + 2 + 2 + 3 + 3);
    EXPECT_EQ(lengthOf({0xD83D, 0xDE00}), 4u);
}

TEST(Utf8Length, counts_an_unpaired_surrogate_as_three_bytes_wherever_it_stands) {
    for (std::size_t size = 1; size <= 40; ++size) {
        for (std::size_t place = 0; place < size; ++place) {
            for (WChar const surrogate : {WChar(0xD800), WChar(0xDBFF), WChar(0xDC00), WChar(0xDFFF)}) {
                reference::WideText text(size, 'a');
                text[place] = surrogate;
                ASSERT_EQ(lengthOf(text), size + 2) << size << ' ' << place;
                if (place + 1 < size) text[place + 1] = 0xDC00;
                ASSERT_EQ(lengthOf(text), plainLength(text)) << size << ' ' << place;
            }
        }
    }
}

TEST(Utf8Length, does_not_pair_with_a_unit_behind_the_length) {
    for (std::size_t size = 1; size <= 40; ++size) {
        reference::WideText text(size, 'a');
        text[size - 1] = 0xD83D;
        text += WChar(0xDE00);
        EXPECT_EQ(Utf::utf8Length(text.data(), size), size + 2) << size;
    }
}

TEST(Utf8Length, sums_long_texts_of_every_kind) {
    for (std::uint32_t character : {0x41u, 0xE9u, 0x20ACu, 0x1F600u}) {
        for (std::size_t size : {1015u, 1016u, 1017u, 1024u, 5000u}) {
            reference::WideText const text = reference::utf16(std::vector<std::uint32_t>(size, character));
            EXPECT_EQ(lengthOf(text), plainLength(text)) << character << ' ' << size;
        }
    }
}

#include "zor_basis/ground/hashing.h"

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

std::uint64_t naiveHash(std::string const& text) {
    std::uint64_t hash = 5381;
    for (char c : text) {
        if (c == '\0') break;
        int const value = static_cast<unsigned char>(c) < 128 ? c & 127 : (c & 255) - 256;
        hash = hash * 33 + static_cast<std::uint64_t>(std::int64_t{value});
    }
    return hash;
}

} // namespace

TEST(HashDjb2, gives_known_values) {
    struct Case {
        Row row;
        char const* text;
        std::uint64_t hash;
    };
    for (Case const& c : {Case{{}, "", 5381}, Case{{}, "a", 177670}, Case{{}, "ab", 177670 * 33 + 98},
                          Case{{}, nullptr, 5381}, Case{{}, "\x7F", 5381 * 33 + 127}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(hashDjb2(c.text, 0), c.hash);
    }
}

TEST(HashDjb2, Kept_hash_01_bytes_from_0x80_on_take_away) {
    EXPECT_EQ(hashDjb2("\xE9", 1), 5381U * 33 - 23);
    EXPECT_EQ(hashDjb2("\x80", 1), 5381U * 33 - 128);
    EXPECT_EQ(hashDjb2("\xFF", 1), 5381U * 33 - 1);
}

TEST(HashDjb2, reads_to_the_terminator_whatever_the_length_says) {
    std::uint64_t const whole = hashDjb2("queue", 5);
    for (std::uint64_t length : {0U, 1U, 4U, 6U, 1000U}) EXPECT_EQ(hashDjb2("queue", length), whole);
    EXPECT_EQ(hashDjb2("que\0ue", 6), hashDjb2("que", 3));
}

TEST(HashDjb2, wraps_around_for_long_text_as_the_plain_sum_does) {
    auto random = randomSource();
    for (std::uint64_t step = 0; step < randomSteps(20'000); ++step) {
        std::string text(random() % 200, '\0');
        for (char& c : text) c = static_cast<char>(1 + random() % 255);
        ASSERT_EQ(hashDjb2(text.c_str(), text.size()), naiveHash(text)) << text;
    }
}

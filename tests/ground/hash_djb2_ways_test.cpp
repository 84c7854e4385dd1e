// The hash by each set of vector instructions, against the plain sum.

#include "tests/support/vectors.h"

#include "zor_basis/ground/hashing.h"

#include <gtest/gtest.h>

#include <cstring>
#include <random>
#include <string>

using namespace ZOR_Basis;

namespace {

struct HashDjb2Ways : EachVectors {};

std::uint64_t plainHash(std::string const& text) {
    std::uint64_t hash = 5381;
    for (char const c : text) hash = hash * 33 + static_cast<std::uint64_t>(std::int64_t{c});
    return hash;
}

} // namespace

INSTANTIATE_FOR_EACH_VECTORS(HashDjb2Ways);

TEST_P(HashDjb2Ways, agree_for_every_length) {
    std::mt19937_64 random(7);
    for (std::size_t size = 0; size < 300; ++size) {
        for (int round = 0; round < 20; ++round) {
            std::string text(size, '\0');
            for (char& c : text) c = static_cast<char>(1 + random() % 255);
            ASSERT_EQ(hashDjb2(text.c_str(), 0), plainHash(text)) << size;
        }
    }
}

TEST_P(HashDjb2Ways, agree_at_every_distance_from_the_end_of_a_page) {
    constexpr std::size_t PAGE = 4096;
    constexpr std::size_t FARTHEST = 40;
    alignas(PAGE) static char pages[2 * PAGE];
    std::mt19937_64 random(11);
    for (std::size_t distance = 1; distance <= FARTHEST; ++distance) {
        for (std::size_t size = 0; size <= FARTHEST; ++size) {
            // Whatever lies before and behind the text does not count.
            for (char& c : pages) c = static_cast<char>(1 + random() % 255);
            char* const text = pages + PAGE - distance;
            text[size] = '\0';
            ASSERT_EQ(hashDjb2(text, 0), plainHash(text)) << size << " bytes, " << distance << " before the end";
        }
    }
}

// Runs the code for processors without SSSE3 on every processor.

#include "basis/ground/hash_djb2.h"

#include "zor_basis/ground/hashing.h"

#include <gtest/gtest.h>

#include <random>
#include <string>

using namespace ZOR_Basis;

TEST(HashDjb2Ways, agree_for_every_length) {
    std::mt19937_64 random(7);
    for (std::size_t size = 0; size < 300; ++size) {
        for (int round = 0; round < 20; ++round) {
            std::string text(size, '\0');
            for (char& c : text) c = static_cast<char>(1 + random() % 255);
            ASSERT_EQ(hashDjb2ByMultiplication(text.c_str()), hashDjb2(text.c_str(), 0)) << size;
        }
    }
}

// Keys that a file holds once, twice, and in great numbers.

#include "tests/store/stored_dict.h"

#include <gtest/gtest.h>

#include <chrono>

using namespace ZOR_Basis;

namespace {

struct DictIndexOfKeys : StoredDict {};

} // namespace

TEST_F(DictIndexOfKeys, Kept_dict_03_reverses_the_order_with_every_load) {
    put(path, fileOf({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    BlobDict dict{Str(path)};
    EXPECT_EQ(content(dict), (Pairs{{"C", "3"}, {"B", "2"}, {"A", "1"}}));
    EXPECT_TRUE(dict.write()) << "nothing to do";
    EXPECT_EQ(textOf(path), fileOf({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    dict.set(blob("D"), blob("4"));
    dict.rm(blob("D"));
    EXPECT_TRUE(dict.write());
    EXPECT_EQ(textOf(path), fileOf({{"C", "3"}, {"B", "2"}, {"A", "1"}}));
    EXPECT_TRUE(dict.read());
    EXPECT_EQ(content(dict), (Pairs{{"A", "1"}, {"B", "2"}, {"C", "3"}}));
}

TEST_F(DictIndexOfKeys, keeps_the_last_value_of_a_key_at_its_first_place) {
    put(path,
        fileOf({{"A", "1"}, {"B", "2"}, {"A", "first"}, {"C", "3"}, {"B", "2"}, {"A", "last"}, {"", "x"}, {"", ""}}));
    BlobDict dict{Str(path)};
    EXPECT_EQ(content(dict), (Pairs{{"", ""}, {"C", "3"}, {"B", "2"}, {"A", "last"}}));
    EXPECT_FALSE(needsSaving(dict));
}

TEST_F(DictIndexOfKeys, loads_many_keys_in_linear_time) {
    std::string bytes;
    constexpr std::uint32_t COUNT = 200'000;
    for (std::uint32_t i = 0; i < COUNT; ++i) bytes += field(length(i)) + field("v");
    put(path, bytes + bytes);
    auto const start = std::chrono::steady_clock::now();
    BlobDict dict{Str(path)};
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(20)) << "a search each takes minutes";
    EXPECT_EQ(dict.size(), COUNT);
    EXPECT_EQ(text(dict.last()->value.key), length(0));
    EXPECT_EQ(text(dict.first()->value.key), length(COUNT - 1));
}

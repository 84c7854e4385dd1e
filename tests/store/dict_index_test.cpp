// The table of keys, and keys that a file holds once, twice, and in great numbers.

#include "basis/store/dict_index.h"

#include "tests/store/stored_dict.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <chrono>
#include <map>
#include <memory>

using namespace ZOR_Basis;

namespace {

struct DictIndexOfKeys : StoredDict {};

} // namespace

TEST(DictIndex, breathes) {
    DictIndex index;
    BlobEntry entry(blob("key"));
    EXPECT_EQ(index.find(3, "key"), nullptr);
    EXPECT_TRUE(index.add(&entry));
    EXPECT_EQ(index.find(3, "key"), &entry);
    EXPECT_EQ(index.find(3, "kex"), nullptr);
    EXPECT_EQ(index.find(0, nullptr), nullptr);
    index.remove(&entry);
    EXPECT_EQ(index.find(3, "key"), nullptr);
}

TEST(DictIndex, finds_keys_of_every_length_by_every_byte) {
    std::string const bytes(40, 'x');
    DictIndex index;
    std::vector<std::unique_ptr<BlobEntry>> entries;
    auto const add = [&](std::string const& key) {
        entries.push_back(std::make_unique<BlobEntry>(blob(key)));
        ASSERT_TRUE(index.add(entries.back().get()));
    };
    for (std::size_t n = 0; n <= bytes.size(); ++n) {
        add(bytes.substr(0, n));
        for (std::size_t i = 0; i < n; ++i) add(bytes.substr(0, i) + "y" + bytes.substr(0, n - i - 1));
    }
    for (auto const& entry : entries) EXPECT_EQ(index.find(entry->key.size(), entry->key.val()), entry.get());
}

TEST(DictIndex, behaves_as_a_map) {
    auto random = randomSource();
    DictIndex index;
    std::map<std::string, std::unique_ptr<BlobEntry>> model;
    for (std::uint64_t left = randomSteps(100'000); left > 0; --left) {
        std::string const key = std::to_string(random() % 300);
        auto const known = model.find(key);
        ASSERT_EQ(index.find(key.size(), key.data()), known != model.end() ? known->second.get() : nullptr) << key;
        if (known == model.end()) {
            BlobEntry* const entry = model.emplace(key, new BlobEntry(blob(key))).first->second.get();
            ASSERT_TRUE(index.add(entry));
        } else {
            index.remove(known->second.get());
            model.erase(known);
        }
    }
}

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

#include "tests/store/stored_dict.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(DictEntry, breathes) {
    BlobEntry entry(blob("key"));
    EXPECT_TRUE(entry.eq(blob("key")));
    EXPECT_FALSE(entry.eq(blob("ke")));
    EXPECT_EQ(entry.value.size(), 0u);
    entry.set(blob("value"));
    entry.set(entry.value);
    EXPECT_EQ(text(entry.value), "value");
    BlobEntry const copy(entry);
    BlobEntry const moved(std::move(entry));
    EXPECT_EQ(text(copy.key), "key");
    EXPECT_EQ(text(moved.value), "value");
    BlobEntry assigned(blob("x"), blob("y"));
    assigned = copy;
    EXPECT_EQ(text(assigned.key), "key");
    assigned = BlobEntry(blob("1"), blob("2"));
    EXPECT_EQ(text(assigned.value), "2");
}

TEST(DictEntry, differs_by_key_or_value_and_is_ordered_by_key_alone) {
    BlobEntry const a1(blob("a"), blob("1"));
    BlobEntry const a2(blob("a"), blob("2"));
    BlobEntry const ab(blob("ab"), blob("0"));
    EXPECT_FALSE(a1 != BlobEntry(a1));
    EXPECT_TRUE(a1 != a2);
    EXPECT_TRUE(a1 != BlobEntry(blob("b"), blob("1")));
    EXPECT_FALSE(a1 < a2);
    EXPECT_FALSE(a2 < a1);
    EXPECT_TRUE(a2 < ab) << "the shorter key first";
    EXPECT_TRUE(BlobEntry(blob("\x7F")) < BlobEntry(blob("\x80")));
}

TEST(DictEntry, sorts_in_the_list_of_a_dictionary) {
    BlobDict dict;
    for (char const* key : {"b", "c", "a", "d"}) dict.set(blob(key), blob(key));
    dict.sort(true);
    EXPECT_EQ(content(dict), (Pairs{{"a", "a"}, {"b", "b"}, {"c", "c"}, {"d", "d"}}));
}

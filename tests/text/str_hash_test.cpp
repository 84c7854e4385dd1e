#include "zor_basis/files/f_path.h"
#include "zor_basis/text.h"

#include <gtest/gtest.h>

#include <string>
#include <unordered_map>
#include <unordered_set>

using namespace ZOR_Basis;

TEST(StrHash, agrees_between_all_narrow_types) {
    for (char const* text : {"", "a", "tray", "a name of more than fifteen bytes"}) {
        std::size_t const expected = std::hash<Str>()(text);
        EXPECT_EQ(std::hash<BufStr<15>>()(text), expected);
        EXPECT_EQ(std::hash<BufStr<255>>()(text), expected);
        EXPECT_EQ(std::hash<HeapStr>()(text), expected);
        EXPECT_EQ(std::hash<FPath>()(text), expected);
    }
    EXPECT_EQ(std::hash<Str>()(Str("ab\0c", 4)), std::hash<Str>()("ab")) << "up to the first zero";
    EXPECT_EQ(std::hash<Str>()(Str("abc", 2)), std::hash<Str>()("ab")) << "at most the size";
    EXPECT_NE(std::hash<Str>()("ab"), std::hash<Str>()("ba"));
    std::unordered_map<Str, int> const sizes{{"tray", 1}, {"stacker", 2}};
    EXPECT_EQ(sizes.at(Str(std::string("stacker"))), 2);
    EXPECT_FALSE(sizes.contains("tra"));
}

TEST(StrHash, agrees_between_all_wide_types) {
    std::size_t const expected = std::hash<WStr>()(ZB_W("tray"));
    EXPECT_EQ(std::hash<WBStr>()(ZB_W("tray")), expected);
    EXPECT_EQ(std::hash<WFxStr>()(ZB_W("tray")), expected);
    EXPECT_EQ(std::hash<WStr>()(WStr(ZB_W("trays"), 4)), expected);
    EXPECT_EQ(std::hash<WStr>()(WStr(ZB_W("tray\0s"), 6)), expected);
    std::unordered_set<WStr> const names{ZB_W("a"), ZB_W("b"), ZB_W("a")};
    EXPECT_EQ(names.size(), 2U);
}

TEST(BlobHash, looks_at_all_bytes) {
    std::hash<Blob> const hash;
    EXPECT_EQ(hash(Blob(3, "a\0b")), hash(Blob(3, "a\0b")));
    EXPECT_NE(hash(Blob(3, "a\0b")), hash(Blob(3, "a\0c")));
    EXPECT_NE(hash(Blob(3, "a\0b")), hash(Blob(1, "a")));
    EXPECT_EQ(hash(Blob()), hash(Blob(0, "a")));
    Blob cut(3, "abc");
    cut.setSize(2);
    EXPECT_EQ(hash(cut), hash(Blob(2, "ab"))) << "bytes in use, not those of the block";
    std::unordered_set<Blob> const keys{Blob(1, "a"), Blob(1, "b"), Blob(1, "a")};
    EXPECT_EQ(keys.size(), 2U);
}

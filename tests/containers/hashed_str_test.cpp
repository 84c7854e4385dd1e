#include <zor_basis/containers/hashed_str.h>

#include <gtest/gtest.h>

#include <string>
#include <unordered_set>

using namespace ZOR_Basis;

namespace {
using Hashed = HashedStr<HeapStr>;
std::uint64_t hashOf(char const* text) { return hashDjb2(text, 0); }
} // namespace

TEST(HashedStr, carries_the_hash_of_its_text_whatever_it_is_made_of) {
    std::string const standard = "page";
    EXPECT_EQ(Hashed().hash(), 5381u);
    EXPECT_TRUE(Hashed().empty());
    for (Hashed const& text : {Hashed("page"), Hashed("pages", 4), Hashed(Str("page")), Hashed(standard)}) {
        EXPECT_STREQ(text.c_str(), "page");
        EXPECT_EQ(text.size(), 4u);
        EXPECT_EQ(text.hash(), hashOf("page"));
        EXPECT_EQ(Hashed(text).hash(), hashOf("page"));
    }
    EXPECT_TRUE(Hashed("page", 0).empty()) << "a length of 0 means empty";
}

TEST(HashedStr, hashes_again_when_the_text_changes) {
    Hashed text("old");
    text = "new";
    EXPECT_EQ(text.hash(), hashOf("new"));
    text = Str("view");
    EXPECT_EQ(text.hash(), hashOf("view"));
    text = std::string("standard");
    EXPECT_EQ(text.hash(), hashOf("standard"));
    text = Hashed("other");
    EXPECT_EQ(text.hash(), hashOf("other"));
    text.set("measured");
    EXPECT_EQ(text.hash(), hashOf("measured"));
    text.set("measured", 3);
    EXPECT_EQ(text.hash(), hashOf("mea"));
    text.str().toUpper();
    text.calcHash();
    EXPECT_EQ(text.hash(), hashOf("MEA"));
    text.clear();
    EXPECT_EQ(text.hash(), 5381u);
}

TEST(HashedStr, compares_hashes_and_then_texts) {
    Hashed const a("alpha");
    Hashed const b("alpha");
    Hashed const c("beta");
    EXPECT_TRUE(a == b && a == a && a != c && !(a != b));
    EXPECT_TRUE(a.eq("alpha") && !a.eq("beta"));
    EXPECT_TRUE(a.eq("alpha", a.hash()) && !a.eq("alpha", a.hash() + 1) && !a.eq("beta", a.hash()));
    std::unordered_set<Hashed> const set{a, b, c};
    EXPECT_EQ(set.size(), 2u);
}

TEST(HashedStr, Kept_hash_03_is_ordered_by_hash_first) {
    Hashed const early("b");   // shorter texts have smaller hashes
    Hashed const later("aaa"); // alphabetically before it
    EXPECT_TRUE(early < later && !(later < early) && !(early < early));
    // "bA" and "ab" have the same hash: the first byte is greater by 1 and counts 33 times, the second is less by 33.
    Hashed const x("bA");
    Hashed const y("ab");
    ASSERT_EQ(x.hash(), y.hash());
    EXPECT_TRUE(y < x && !(x < y) && x != y);
}

#include "zor_basis/files/f_path.h"
#include "zor_basis/text.h"

#include "tests/text/call_content.h"

#include <gtest/gtest.h>

#include <atomic>
#include <climits>
#include <limits>
#include <string>

using namespace ZOR_Basis;

namespace {

template <class Text>
class BufStrCalls : public testing::Test {};

using CalledBufStrs = testing::Types<BufStr<15>, BufStr<255>>;
TYPED_TEST_SUITE(BufStrCalls, CalledBufStrs, );

} // namespace

TYPED_TEST(BufStrCalls, extend_a_text) {
    std::string const string("xyz");
    TypeParam text;
    text.add("abc").add("abc", 2).add("abc", 0).add(Str("abc", 1)).add(string).add(string, 1).add('c').add(100).add(0);
    EXPECT_EQ(contentOfAny(text), "abcababcaxyzxcd");
    text.clear();
    text += "a";
    text += Str("bc", 1);
    text += string;
    text += 'c';
    text += 100;
    text += static_cast<char const*>(nullptr);
    text += HeapStr("e");
    text += BufStr<15>("f");
    EXPECT_EQ(contentOfAny(text), "abxyzcdef");
    text.clear();
    text << "a" << Str("bc", 1) << string << HeapStr("d") << BufStr<255>("e") << static_cast<char const*>(nullptr);
    EXPECT_EQ(contentOfAny(text), "abxyzde");
    text.copy("abc").copy("abc", 2).insert(1, "x").insert(0, Str("yz", 1)).replace(0, 1, "q").replace(0, 1, Str("r"));
    EXPECT_EQ(contentOfAny(text), "raxb");
    text.replaceTail(2, "s").replaceTail(3, Str("t"));
    EXPECT_EQ(contentOfAny(text), "rast");
}

namespace {

template <class Text, class Number>
std::string streamed(Number number) {
    Text text("=");
    text << number;
    return contentOfAny(text);
}

} // namespace

TYPED_TEST(BufStrCalls, stream_integers_of_every_size_whole) {
    using Text = TypeParam;
    EXPECT_EQ(streamed<Text>(0), "=0");
    EXPECT_EQ(streamed<Text>(INT_MIN), "=-2147483648");
    EXPECT_EQ(streamed<Text>(INT_MAX), "=2147483647");
    EXPECT_EQ(streamed<Text>(5'000'000'000), "=5000000000");
    EXPECT_EQ(streamed<Text>(-5'000'000'000), "=-5000000000");
    EXPECT_EQ(streamed<Text>(4'000'000'000U), "=4000000000");
    EXPECT_EQ(streamed<Text>(2'147'483'648L), "=2147483648");
    EXPECT_EQ(streamed<Text>(std::numeric_limits<std::int64_t>::min()), "=-9223372036854775808");
    EXPECT_EQ(streamed<Text>(std::numeric_limits<std::int64_t>::max()), "=9223372036854775807");
    EXPECT_EQ(streamed<Text>(std::numeric_limits<std::uint64_t>::max()), "=18446744073709551615");
    EXPECT_EQ(streamed<Text>(std::numeric_limits<long>::min()), "=" + std::to_string(LONG_MIN));
    EXPECT_EQ(streamed<Text>(static_cast<short>(-3)), "=-3");
    EXPECT_EQ(streamed<Text>(static_cast<unsigned short>(65535)), "=65535");
}

TYPED_TEST(BufStrCalls, stream_characters_enumerators_and_the_like_as_numbers) {
    using Text = TypeParam;
    enum Small { SMALL = -7 };
    enum Large : std::uint64_t { LARGE = 18'446'744'073'709'551'615U };
    enum Narrow : unsigned char { NARROW = 200 };
    EXPECT_EQ(streamed<Text>('g'), "=103") << "a character is the number that it is";
    EXPECT_EQ(streamed<Text>(static_cast<signed char>(-1)), "=-1");
    EXPECT_EQ(streamed<Text>(static_cast<unsigned char>(255)), "=255");
    EXPECT_EQ(streamed<Text>(char32_t{0x10FFFF}), "=1114111");
    EXPECT_EQ(streamed<Text>(true), "=1");
    EXPECT_EQ(streamed<Text>(false), "=0");
    EXPECT_EQ(streamed<Text>(SMALL), "=-7");
    EXPECT_EQ(streamed<Text>(LARGE), "=18446744073709551615");
    EXPECT_EQ(streamed<Text>(NARROW), "=200");
    std::atomic<int> const shared{42};
    Text text;
    text << shared;
    EXPECT_EQ(contentOfAny(text), "42") << "what converts to an int is one";
}

namespace {

template <class Text, class Source>
concept Streams = requires(Text& text, Source const& source) {
    text << source;
};
template <class Text, class Source>
concept Adds = requires(Text& text, Source const& source) {
    text.add(source);
};
enum class Scoped { ONE };

static_assert(Streams<BufStr<15>, int> && Streams<FPath, std::uint64_t> && Streams<BufStr<255>, std::atomic<int>>);
static_assert(!Streams<BufStr<15>, double> && !Streams<BufStr<255>, float> && !Streams<FPath, long double>);
static_assert(!Streams<BufStr<15>, std::atomic<std::int64_t>> && !Streams<BufStr<15>, std::atomic<double>>);
static_assert(!Streams<BufStr<15>, Scoped> && !Streams<BufStr<15>, void*> && !Streams<BufStr<15>, WChar const*>);
static_assert(Adds<FPath, char> && !Adds<FPath, int> && !Adds<FPath, unsigned char>);

} // namespace

// Every stated way to make, assign, extend and stream a narrow text keeps its meaning, whatever other overloads there
// are. Where two overloads could be taken their effects differ, so that the row tells which one was.

#include "zor_basis/files/f_path.h"
#include "zor_basis/text.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <atomic>
#include <climits>
#include <cstring>
#include <limits>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

using namespace ZOR_Basis;

namespace {

std::string content(Str const& text) { return {text.c_str(), text.size()}; }

template <class Text>
class Calls : public testing::Test {
protected:
    /// An array that is longer than its text.
    char array[8] = {'a', 'b', 'c', '\0', 'x', 'y', 'z', '\0'};
    char* const writable = array;
    char const* const plain = array;
    std::string const string{"abc"};
};

using Texts = testing::Types<BufStr<15>, BufStr<255>, HeapStr, FPath>;
TYPED_TEST_SUITE(Calls, Texts, );

template <class Text>
class Views : public testing::Test {};
TYPED_TEST_SUITE(Views, Texts, );

template <class Text>
inline constexpr bool measuresZero = !std::is_same_v<Text, HeapStr>;

/// Not terminated: a sanitizer sees what reads behind the end.
struct Unterminated {
    explicit Unterminated(std::string_view text) : bytes(text.begin(), text.end()) {}
    operator std::string_view() const { return {bytes.data(), bytes.size()}; }
    std::string_view get() const { return *this; }
    std::vector<char> bytes;
};

} // namespace

TYPED_TEST(Calls, make_a_text_from_every_source) {
    using Text = TypeParam;
    Str const part(this->plain, 2);
    Str const none(this->plain, 0);
    EXPECT_EQ(content(Text()), "");
    EXPECT_EQ(content(Text{}), "");
    EXPECT_EQ(content(Text("abc")), "abc");
    EXPECT_EQ(content(Text(this->array)), "abc");
    EXPECT_EQ(content(Text(this->writable)), "abc");
    EXPECT_EQ(content(Text(this->plain)), "abc");
    EXPECT_EQ(content(Text{this->plain}), "abc");
    EXPECT_EQ(content(Text(nullptr)), "");
    EXPECT_EQ(content(Text(static_cast<char const*>(nullptr))), "");
    EXPECT_EQ(content(Text(this->string)), "abc");
    EXPECT_EQ(content(Text(std::string("a\0b", 3))), std::string("a\0\0", 3));
    EXPECT_EQ(content(Text(part)), "ab");
    EXPECT_EQ(content(Text(none)), measuresZero<Text> ? "abc" : "");
    EXPECT_EQ(content(Text(BufStr<15>("abc"))), "abc");
    EXPECT_EQ(content(Text(BufStr<255>("abc"))), "abc");
    EXPECT_EQ(content(Text(HeapStr("abc"))), "abc");
    EXPECT_EQ(content(Text(FPath("abc"))), "abc");
    Text const converted = this->plain;
    EXPECT_EQ(content(converted), "abc");
}

TYPED_TEST(Calls, make_a_text_from_a_pointer_and_a_length) {
    using Text = TypeParam;
    EXPECT_EQ(content(Text(this->plain, 2)), "ab");
    EXPECT_EQ(content(Text(this->array, 2U)), "ab");
    EXPECT_EQ(content(Text(this->writable, 2L)), "ab");
    EXPECT_EQ(content(Text("abc", std::uint64_t{2})), "ab");
    EXPECT_EQ(content(Text(this->plain, sizeof(char))), "a");
    EXPECT_EQ(content(Text(this->plain, 0)), measuresZero<Text> ? "abc" : "");
    EXPECT_EQ(content(Text(nullptr, 3)), "");
    EXPECT_EQ(content(Text{"abc", 2}), "ab");
    Text const listed = {"abc", 2};
    EXPECT_EQ(content(listed), "ab");
}

TYPED_TEST(Calls, assign_every_source) {
    Str const part(this->plain, 2);
    Str const none(this->plain, 0);
    TypeParam text("old");
    EXPECT_EQ(content(text = "abc"), "abc");
    EXPECT_EQ(content(text = this->array), "abc");
    EXPECT_EQ(content(text = this->writable), "abc");
    EXPECT_EQ(content(text = part), "ab");
    EXPECT_EQ(content(text = none), measuresZero<TypeParam> ? "abc" : "");
    EXPECT_EQ(content(text = this->string), "abc");
    EXPECT_EQ(content(text = nullptr), "");
    EXPECT_EQ(content(text = BufStr<15>("abc")), "abc");
    EXPECT_EQ(content(text = BufStr<255>("de")), "de");
    EXPECT_EQ(content(text = HeapStr("abc")), "abc");
    EXPECT_EQ(content(text = FPath("de")), "de");
    EXPECT_EQ(content(text = TypeParam("abc")), "abc");
    EXPECT_EQ(content(text = text.c_str()), "abc");
    EXPECT_EQ(content(text = {}), "");
    static_assert(std::is_same_v<decltype(text = "abc"), TypeParam&>);
}

TEST(CallsOfHeapStr, set_a_text) {
    HeapStr text;
    EXPECT_EQ(content(text.set("abc")), "abc");
    EXPECT_EQ(content(text.set("abc", 2)), "ab");
    EXPECT_EQ(content(text.set("abc", 0)), "");
    EXPECT_EQ(content(text.set(nullptr)), "");
}

template <class Text>
class CallsOfBufStr : public testing::Test {};
using Sizes = testing::Types<BufStr<15>, BufStr<255>>;
TYPED_TEST_SUITE(CallsOfBufStr, Sizes, );

TYPED_TEST(CallsOfBufStr, extend_a_text) {
    std::string const string("xyz");
    TypeParam text;
    text.add("abc").add("abc", 2).add("abc", 0).add(Str("abc", 1)).add(string).add(string, 1).add('c').add(100).add(0);
    EXPECT_EQ(content(text), "abcababcaxyzxcd");
    text.clear();
    text += "a";
    text += Str("bc", 1);
    text += string;
    text += 'c';
    text += 100;
    text += static_cast<char const*>(nullptr);
    text += HeapStr("e");
    text += BufStr<15>("f");
    EXPECT_EQ(content(text), "abxyzcdef");
    text.clear();
    text << "a" << Str("bc", 1) << string << HeapStr("d") << BufStr<255>("e") << static_cast<char const*>(nullptr);
    EXPECT_EQ(content(text), "abxyzde");
    text.copy("abc").copy("abc", 2).insert(1, "x").insert(0, Str("yz", 1)).replace(0, 1, "q").replace(0, 1, Str("r"));
    EXPECT_EQ(content(text), "raxb");
    text.replaceTail(2, "s").replaceTail(3, Str("t"));
    EXPECT_EQ(content(text), "rast");
}

TYPED_TEST(CallsOfBufStr, stream_numbers_of_every_type_whole) {
    enum Small { SMALL = -7 };
    enum Large : std::uint64_t { LARGE = 18'446'744'073'709'551'615U };
    enum Narrow : unsigned char { NARROW = 200 };
    auto streamed = [](auto number) {
        TypeParam text("=");
        text << number;
        return content(text);
    };
    EXPECT_EQ(streamed(0), "=0");
    EXPECT_EQ(streamed(INT_MIN), "=-2147483648");
    EXPECT_EQ(streamed(INT_MAX), "=2147483647");
    EXPECT_EQ(streamed(5'000'000'000), "=5000000000");
    EXPECT_EQ(streamed(-5'000'000'000), "=-5000000000");
    EXPECT_EQ(streamed(4'000'000'000U), "=4000000000");
    EXPECT_EQ(streamed(2'147'483'648L), "=2147483648");
    EXPECT_EQ(streamed(std::numeric_limits<std::int64_t>::min()), "=-9223372036854775808");
    EXPECT_EQ(streamed(std::numeric_limits<std::int64_t>::max()), "=9223372036854775807");
    EXPECT_EQ(streamed(std::numeric_limits<std::uint64_t>::max()), "=18446744073709551615");
    EXPECT_EQ(streamed(std::numeric_limits<long>::min()), "=" + std::to_string(LONG_MIN));
    EXPECT_EQ(streamed(static_cast<short>(-3)), "=-3");
    EXPECT_EQ(streamed(static_cast<unsigned short>(65535)), "=65535");
    EXPECT_EQ(streamed('g'), "=103") << "a character is the number that it is";
    EXPECT_EQ(streamed(static_cast<signed char>(-1)), "=-1");
    EXPECT_EQ(streamed(static_cast<unsigned char>(255)), "=255");
    EXPECT_EQ(streamed(char32_t{0x10FFFF}), "=1114111");
    EXPECT_EQ(streamed(true), "=1");
    EXPECT_EQ(streamed(false), "=0");
    EXPECT_EQ(streamed(SMALL), "=-7");
    EXPECT_EQ(streamed(LARGE), "=18446744073709551615");
    EXPECT_EQ(streamed(NARROW), "=200");
    std::atomic<int> const shared{42};
    TypeParam text;
    text << shared;
    EXPECT_EQ(content(text), "42") << "what converts to an int is one";
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

TEST(CallsOfFPath, make_a_path_from_two_parts) {
    std::string const string("d");
    Str const part("dx", 1);
    char const* const plain = "n";
    EXPECT_EQ(content(FPath(part, Str("n"))), "d/n");
    EXPECT_EQ(content(FPath(part, "n")), "d/n");
    EXPECT_EQ(content(FPath("d", plain)), "d/n");
    EXPECT_EQ(content(FPath(plain, part)), "n/d");
    EXPECT_EQ(content(FPath(string, plain)), "d/n");
    EXPECT_EQ(content(FPath(string, string)), "d/d");
    EXPECT_EQ(content(FPath(FPath("d"), BufStr<15>("n"))), "d/n");
    EXPECT_EQ(content(FPath(FPath("d"), string)), "d/d");
    EXPECT_EQ(content(FPath("abc", 1)), "a");
    EXPECT_EQ(content(FPath("abc", 1U)), "a");
    EXPECT_EQ(content(FPath("abc", 0)), "abc");
    EXPECT_EQ(content(FPath("abc", TranslPath())), "abc");
    EXPECT_EQ(content(FPath(part, TranslPath())), "d");
    FPath path;
    EXPECT_EQ(content(path.assign(part, Str("n"))), "d/n");
    EXPECT_EQ(content(path.assign(part, "n")), "d/n");
}

TEST(CallsOfFPath, extend_a_path) {
    std::string const string("s");
    FPath path("d");
    path.add("abc", 1).add("b").add(Str("cx", 1)).add(FPath("e")).add(string).add(nullptr);
    EXPECT_EQ(content(path), "d/a/b/c/e/s");
    path = "d";
    path += "a";
    path += Str("bx", 1);
    path += string;
    path += BufStr<15>("c");
    EXPECT_EQ(content(path), "d/a/b/s/c");
    path = "d";
    path << "a" << Str("bx", 1) << 7;
    EXPECT_EQ(content(path), "dab7") << "streaming joins nothing";
}

TEST(CallsOfFPath, append_a_component_of_one_character) {
    struct Case {
        Row row;
        char const* before;
        char added;
        char const* after;
    };
    for (Case const& c : {Case{{}, "dir", 'z', "dir/z"}, Case{{}, "dir/", 'z', "dir/z"}, Case{{}, "", 'z', "z"},
                          Case{{}, "dir", '\0', "dir"}, Case{{}, "dir", '/', "dir//"}}) {
        SCOPED_TRACE(c.row);
        FPath path(c.before);
        EXPECT_EQ(&path.add(c.added), &path);
        EXPECT_EQ(content(path), c.after);
        FPath other(c.before);
        EXPECT_EQ(&(other += c.added), &other);
        EXPECT_EQ(content(other), c.after);
    }
}

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wzero-as-null-pointer-constant"

TYPED_TEST(Calls, take_a_literal_0_for_a_null_pointer) {
    EXPECT_EQ(content(TypeParam(0)), "");
    TypeParam text("old");
    EXPECT_EQ(content(text = 0), "");
    EXPECT_TRUE(text == 0 && 0 == text && !(text != 0) && text <= 0 && 0 >= text && !(text < 0));
    EXPECT_EQ(content(FPath("a").add(0)), "a");
    EXPECT_EQ(content(FPath("a") += 0), "a");
    EXPECT_EQ(content(BufStr<15>("a").add(0)), "a") << "or for a byte, which appends nothing either";
    EXPECT_EQ(content(BufStr<15>("a") << 0), "a0") << "but for a number, where a number is stated";
}

#pragma GCC diagnostic pop

// ---- standard views -------------------------------------------------------------------------------------------------

static_assert(!std::is_constructible_v<Str, std::string_view> && !std::is_assignable_v<Str&, std::string_view>);
static_assert(!std::is_convertible_v<Str, std::string_view> && !std::is_convertible_v<HeapStr, std::string_view>);

TYPED_TEST(Views, are_copied_as_standard_strings_are) {
    using namespace std::string_literals;
    static_assert(std::is_convertible_v<std::string_view, TypeParam>);
    for (std::string const& text : {""s, "a"s, "abc"s, "a name of 16 byt"s, "ab\0cd"s, "\0"s, "\0ab"s,
                                    std::string(255, 'x'), std::string(300, 'y')}) {
        SCOPED_TRACE(text);
        Unterminated const view(text);
        TypeParam const expected(text);
        EXPECT_EQ(content(TypeParam(view.get())), content(expected));
        TypeParam const converted = view.get();
        EXPECT_EQ(content(converted), content(expected));
        EXPECT_EQ(converted.c_str()[converted.size()], '\0');
        TypeParam assigned("what was there before");
        EXPECT_EQ(&(assigned = view.get()), &assigned);
        EXPECT_EQ(content(assigned), content(expected));
        EXPECT_EQ(assigned.c_str()[assigned.size()], '\0');
    }
}

TYPED_TEST(Views, of_nothing_are_the_empty_text_and_never_measured) {
    char const* const text = "abc";
    EXPECT_EQ(content(TypeParam(std::string_view())), "");
    EXPECT_EQ(content(TypeParam(std::string_view(text, 0))), "");
    TypeParam assigned("old");
    assigned = std::string_view(text, 0);
    EXPECT_EQ(content(assigned), "");
    assigned = "old";
    assigned = std::string_view();
    EXPECT_EQ(content(assigned), "");
}

TYPED_TEST(Views, of_the_own_text_are_copied_first) {
    TypeParam text("a text that is longer than fifteen bytes");
    text = std::string_view(text).substr(2);
    EXPECT_EQ(content(text), "text that is longer than fifteen bytes");
    text = std::string_view(text).substr(5, 7);
    EXPECT_EQ(content(text), "that is");
    text = std::string_view(text).substr(0, 4);
    EXPECT_EQ(content(text), "that");
    text = std::string_view(text);
    EXPECT_EQ(content(text), "that");
    text = std::string_view(text).substr(1, 0);
    EXPECT_EQ(content(text), "");
}

TYPED_TEST(CallsOfBufStr, extend_a_text_by_views) {
    Unterminated const view("abc");
    char const* const plain = "xyz";
    TypeParam text;
    EXPECT_EQ(&text.add(view.get()), &text);
    text += view.get().substr(1);
    text << view.get().substr(2) << std::string_view(plain, 0) << std::string_view();
    EXPECT_EQ(content(text), "abcbcc");
    text.add(std::string_view(text).substr(3));
    EXPECT_EQ(content(text), "abcbccbcc");
}

TEST(CallsOfFPath, extend_a_path_by_views) {
    Unterminated const view("abc");
    FPath path("d");
    EXPECT_EQ(&path.add(view.get()), &path);
    path += view.get().substr(1);
    path.add(std::string_view(path.c_str(), 0));
    path += std::string_view();
    EXPECT_EQ(content(path), "d/abc/bc");
    path << view.get();
    EXPECT_EQ(content(path), "d/abc/bcabc");
}

// ---- hashes ---------------------------------------------------------------------------------------------------------

TEST(TextHash, agrees_between_all_narrow_types) {
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

TEST(TextHash, agrees_between_all_wide_types) {
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

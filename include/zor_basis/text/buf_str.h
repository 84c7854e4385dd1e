/// \file
/// `BufStr<15>` and `BufStr<255>`: narrow strings that keep short text inside the object.
///
/// Up to N bytes lie in the object itself, usually on the stack; longer text lies in a heap block of exactly the
/// required size. A string never returns from the heap: `clear`, `cut` and shorter texts keep the block and its
/// capacity for the next long text. No text is ever truncated.
///
///     BufStr<15> name("page-");
///     name << 7 << ".ps"; // "page-7.ps", without an allocation
///
/// In every member a source may lie inside the string's own text: nothing is released or overwritten before it has been
/// copied. A source with a length is copied up to its terminator, see text-06. If memory is short, the program is
/// aborted. There are no move operations: a move copies.
///
/// A `std::string_view` is treated like a `std::string` with the same bytes: an empty one is the empty text, a zero in
/// it follows text-06, and nothing behind its end is read. `Str` describes how texts compare, and how to search a
/// container of texts for a literal; a `std::string_view` compares as the `std::string` would.

#ifndef ZOR_BASIS_TEXT_BUF_STR_H
#define ZOR_BASIS_TEXT_BUF_STR_H

#include "zor_basis/text/inline_text.h"
#include "zor_basis/text/str.h"
#include "zor_basis/text/view_ops.h"

#include <compare>
#include <concepts>
#include <cstdint>
#include <cstdlib>
#include <functional>
#include <string>
#include <string_view>

namespace ZOR_Basis {

/// \kept text-04: an assigned text of N bytes or more lies on the heap: 15 bytes in a `BufStr<15>` give a capacity of
///     16
/// \kept text-05: appending keeps a text inside the object up to exactly N bytes
/// \kept text-06: a source with a given length is copied up to its terminator and padded with zeros, and the size
///     becomes the given length
/// \kept text-07: a text that is on the heap stays on the heap, with a capacity that never shrinks
/// \kept text-08: growth is exact, without doubling or rounding: appending a byte to a full block allocates a block
///     that is one byte larger
template <std::uint64_t N>
requires(N == 15 || N == 255) class BufStr : public Str {
    using Text = detail::InlineText<BufStr, char, N>;
    friend Text;

public:
    /// Empty, inside the object.
    BufStr() noexcept { Text::start(*this); }
    /// Copy a text, with the same result as assigning it to an empty string.
    BufStr(char const* text, std::uint64_t n = 0) noexcept { Text::make(*this, text, n); }
    BufStr(Str const& text) noexcept { Text::make(*this, text.c_str(), text.size()); }
    BufStr(std::string const& text) noexcept { Text::makeOwned(*this, text.c_str(), text.size()); }
    template <detail::StringView View>
    BufStr(View text) noexcept {
        Text::makeOwned(*this, text.empty() ? StrEmpty : text.data(), text.size());
    }
    BufStr(BufStr const& other) noexcept : Str(other) { Text::makeOwned(*this, other.text_, other.size_); }
    ~BufStr() { Text::end(*this); }

    /// Assigns a copy of the text. Assigning the string itself or its own text pointer changes nothing.
    BufStr& operator=(BufStr const& other) {
        if (this != &other) Text::assignOwned(*this, other.text_, other.size_);
        return *this;
    }
    BufStr& operator=(Str const& text) {
        if (this != &text) Text::assign(*this, text.c_str(), text.size());
        return *this;
    }
    BufStr& operator=(std::string const& text) {
        Text::assignOwned(*this, text.c_str(), text.size());
        return *this;
    }
    BufStr& operator=(char const* text) {
        if (text != text_) Text::assign(*this, text, 0);
        return *this;
    }
    template <detail::StringView View>
    BufStr& operator=(View text) {
        Text::assign(*this, text.empty() ? StrEmpty : text.data(), text.size());
        return *this;
    }
    BufStr& copy(char const* text, std::uint64_t n = 0) {
        Text::assign(*this, text, n);
        return *this;
    }

    using Str::compare;
    /// As for any two texts, only faster.
    template <std::same_as<BufStr> Other>
    int compare(Other const& other) const noexcept {
        return detail::compareOwned<N>(text_, size_, other.text_, other.size_);
    }

    /// Appends a text; an empty source changes nothing.
    BufStr& add(char const* text, std::uint64_t n = 0) {
        Text::append(*this, text, n);
        return *this;
    }
    BufStr& add(Str const& text) { return add(text.c_str(), text.size()); }
    /// Appends the first n bytes; all of them for n = 0 and for n beyond the size.
    BufStr& add(std::string const& text, std::uint64_t n = 0) {
        return add(text.c_str(), n != 0 && n < text.size() ? n : text.size());
    }
    template <detail::StringView View>
    BufStr& add(View text) {
        return text.empty() ? *this : add(text.data(), text.size());
    }
    /// Appends one byte.
    /// \kept text-09: the byte 0 appends nothing
    template <detail::Index C>
    BufStr& add(C c) {
        Text::append(*this, static_cast<char>(c));
        return *this;
    }
    BufStr& operator+=(std::string const& text) { return add(text); }
    BufStr& operator+=(Str const& text) { return add(text); }
    BufStr& operator+=(char const* text) { return add(text); }
    template <detail::StringView View>
    BufStr& operator+=(View text) {
        return add(text);
    }
    template <detail::Index C>
    BufStr& operator+=(C c) {
        return add(c);
    }
    BufStr& operator<<(Str const& text) { return add(text); }
    BufStr& operator<<(char const* text) { return add(text); }
    template <detail::StringView View>
    BufStr& operator<<(View text) {
        return add(text);
    }
    /// Appends the decimal digits of an integer of any size. Types that lose information as an integer do not compile.
    /// \kept text-15: characters, Boolean values and enumerators count as numbers; `+=` appends a character itself
    BufStr& operator<<(int number) { return addNumber(std::int64_t{number}); }
    template <detail::Number I>
    BufStr& operator<<(I number) { // kept text-15: 'a' appends "97"
        using Wide = std::conditional_t<std::is_signed_v<decltype(+number)>, std::int64_t, std::uint64_t>;
        return addNumber(static_cast<Wide>(+number));
    }
    template <detail::LosesAsInt T>
    BufStr& operator<<(T const&) = delete;

    /// The byte at an index, for writing; the index is not checked.
    template <detail::Index I>
    char& operator[](I index) noexcept {
        return getBuf()[static_cast<std::uint64_t>(index)];
    }
    /// The byte at an index; 0 at the size and beyond.
    template <detail::Index I>
    char operator[](I index) const noexcept {
        auto const i = static_cast<std::uint64_t>(index);
        return i < size_ ? text_[i] : '\0';
    }

    /// The text for direct writing, capacity + 1 bytes; must be followed by `resize` or `setSize`.
    char* getBuf() noexcept { return Text::text(*this); }
    /// The capacity: N inside the object, otherwise the block's; the terminator is not counted.
    std::uint64_t sizeBuf() const noexcept { return Text::capacity(*this); }
    /// Ensures a capacity of at least max(n, size + 1); keeps the text up to an inner terminator.
    BufStr& extendBuf(std::uint64_t n) {
        CopyIfTooLong(text_, n, size_);
        return *this;
    }
    /// Measures the text again after direct writes, at most n bytes of it; n = 0 sets no bound.
    /// \kept text-10: first stores a terminator at the index of the capacity, so a completely filled buffer loses its
    ///     last byte but is terminated
    BufStr& resize(std::uint64_t n = 0) noexcept {
        Text::resize(*this, n);
        return *this;
    }
    /// Sets the size to n and stores a terminator there.
    /// \pre n is at most the capacity, and no zero is among the first n bytes; nothing is checked
    BufStr& setSize(std::uint64_t n) noexcept {
        Text::setSize(*this, n);
        return *this;
    }
    /// Empties the text; a block is kept.
    BufStr& clear() noexcept {
        Text::setSize(*this, 0);
        return *this;
    }
    /// Removes the last byte, if there is one.
    BufStr& cut() noexcept {
        Text::cutLast(*this);
        return *this;
    }
    /// Cuts the text to n bytes; a shorter text is only terminated again at its size.
    BufStr& cut(std::uint64_t n) noexcept {
        Text::cutTo(*this, n);
        return *this;
    }

    /// Inserts a text; a position behind the size has no effect. The bytes that follow move, including inner zeros.
    BufStr& insert(std::uint64_t pos, char const* text, std::uint64_t n = 0) {
        Text::insert(*this, pos, text, n);
        return *this;
    }
    BufStr& insert(std::uint64_t pos, Str const& text) { return insert(pos, text.c_str(), text.size()); }
    /// Replaces `count` bytes, or as many as there are, by a text; a count of 0 inserts, and an empty source only
    /// removes. At the size the text is appended; a position behind the size has no effect.
    BufStr& replace(std::uint64_t pos, std::uint64_t count, char const* text, std::uint64_t n = 0) {
        Text::replace(*this, pos, count, text, n);
        return *this;
    }
    BufStr& replace(std::uint64_t pos, std::uint64_t count, Str const& text) {
        return replace(pos, count, text.c_str(), text.size());
    }
    /// Cuts a text that is longer than `pos` bytes to `pos` bytes, then appends.
    BufStr& replaceTail(std::uint64_t pos, char const* text, std::uint64_t n = 0) {
        Text::replaceTail(*this, pos, text, n);
        return *this;
    }
    BufStr& replaceTail(std::uint64_t pos, Str const& text) { return replaceTail(pos, text.c_str(), text.size()); }

    /// Changes all bytes by the runtime's `tolower` and `toupper`.
    BufStr& toLower() noexcept {
        ToLower(getBuf(), size_);
        return *this;
    }
    BufStr& toUpper() noexcept {
        ToUpper(getBuf(), size_);
        return *this;
    }

    /// Assigns the bytes of a zero-terminated text as two lower-case hexadecimal digits each: "AZ" gives "415a".
    BufStr& toHex(char const* text);
    /// Appends one byte for each pair of hexadecimal digits, decoded like `decodeHexChar`. An odd last digit is
    /// ignored.
    /// \kept text-11: a pair that gives 0 appends nothing: "41004200" appends "AB"
    BufStr& fromHex(char const* digits);

    /// Increments the text as a number with digits a to z: "" becomes "a", "a" becomes "b", "az" becomes "ba", "zz"
    /// becomes "aaa".
    /// \kept text-12: every character other than "z" is incremented, letter or not: "Z" becomes "["
    BufStr& NextLatin() {
        NextLatin(*this, size_ != 0 ? size_ - 1 : 0);
        return *this;
    }
    /// The same from the byte at `pos` to the left; an empty string becomes "a", and a position behind the last byte
    /// has no effect.
    static void NextLatin(BufStr& text, std::uint64_t pos) { Text::nextLatin(text, pos); }

protected:
    /// Checks the capacity; every block is allocated here. If max(need, keep + 1) exceeds the capacity, moves to a new
    /// block of exactly that capacity and copies `keep` bytes of the source, by text-06, and a terminator.
    /// \return whether there is a new block; the caller sets the size
    bool CopyIfTooLong(char const* source, std::uint64_t need, std::uint64_t keep) {
        return Text::copyIfTooLong(*this, source, need, keep);
    }
    /// Allocates n bytes from the runtime's heap.
    char* alloc(std::uint64_t n) noexcept { return static_cast<char*>(std::malloc(n)); }
    /// Releases the text.
    void free() noexcept { std::free(getBuf()); }

    /// Compare with a `std::string_view` by the rules of `std::string`.
    template <detail::StringView View>
    friend bool operator==(BufStr const& a, View b) noexcept {
        return detail::sameAsView(a, b);
    }
    template <detail::StringView View>
    friend bool operator==(View a, BufStr const& b) noexcept {
        return detail::viewSameAs(a, b);
    }
    template <detail::StringView View>
    friend std::weak_ordering operator<=>(BufStr const& a, View b) noexcept {
        return detail::compareWithView(a.text_, b) <=> 0;
    }

private:
    BufStr& addNumber(std::int64_t number);
    BufStr& addNumber(std::uint64_t number);

    detail::TextArea<char, N> area_;
};

/// Equality and order of two strings of the same kind: as for any two texts, only faster.
template <std::uint64_t N>
bool operator==(BufStr<N> const& a, BufStr<N> const& b) noexcept {
    // kept text-01: the right-hand size decides here too
    if (b.size() == 0) [[unlikely]]
        return a.eq(b.c_str(), 0);
    return a.size() == b.size() && detail::sameOwned<N>(a.c_str(), b.c_str(), b.size());
}
template <std::uint64_t N>
std::weak_ordering operator<=>(BufStr<N> const& a, BufStr<N> const& b) noexcept {
    return detail::compareOwned<N>(a.c_str(), a.size(), b.c_str(), b.size()) <=> 0;
}

/// The string for everyday use: names, extensions, small numbers.
ZB_EXTERN_TEMPLATE detail::InlineText<BufStr<15>, char, 15>;
ZB_EXTERN_TEMPLATE BufStr<15>;
/// The string for paths.
ZB_EXTERN_TEMPLATE detail::InlineText<BufStr<255>, char, 255>;
ZB_EXTERN_TEMPLATE BufStr<255>;

template <std::uint64_t N>
inline constexpr bool detail::IS_TEXT<BufStr<N>> = true;

static_assert(sizeof(BufStr<15>) == 32 && sizeof(BufStr<255>) == 272);

} // namespace ZOR_Basis

template <std::uint64_t N>
struct std::hash<ZOR_Basis::BufStr<N>> : std::hash<ZOR_Basis::Str> {};

#endif

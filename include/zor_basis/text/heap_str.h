/// \file
/// `HeapStr`: a narrow string whose text always lies in a heap block of exactly its length, or is the shared empty
/// text.
///
/// It is meant for texts that are stored for long: the object is two words and a capacity, without an inline area. Text
/// cannot be appended; build it in a `BufStr` and store the result here. A source may lie inside the string's own text;
/// it is copied up to its terminator and padded with zeros (text-06). If memory is short, the program is aborted. There
/// are no move operations: a move copies. A `std::string_view` is treated and compared like a `std::string` with the
/// same bytes.
///
///     HeapStr const stored(BufStr<255>("job ") << number);

#ifndef ZOR_BASIS_TEXT_HEAP_STR_H
#define ZOR_BASIS_TEXT_HEAP_STR_H

#include "zor_basis/text/str.h"
#include "zor_basis/text/view_ops.h"

#include <compare>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace ZOR_Basis {

/// \kept text-13: here a length of 0 means "empty", and a text is not measured: a view of size 0 on "x" gives the empty
///     string, and a source that begins with the terminator keeps its length
class ZB_API HeapStr : public Str {
public:
    HeapStr() noexcept : capacity_(0) {}
    /// Measures the text; null gives the empty string.
    HeapStr(char const* text);
    /// Copies exactly n bytes; empty for n = 0 and for null.
    HeapStr(char const* text, std::uint64_t n);
    HeapStr(Str const& text);
    HeapStr(std::string const& text);
    template <detail::StringView View>
    HeapStr(View text) : HeapStr(text.data(), text.size()) {}
    HeapStr(HeapStr const& other);
    ~HeapStr();

    /// Call `set` with the size of the source.
    HeapStr& operator=(HeapStr const& other);
    HeapStr& operator=(Str const& text);
    HeapStr& operator=(std::string const& text);
    template <detail::StringView View>
    HeapStr& operator=(View text) {
        return set(text.data(), text.size());
    }
    /// Calls `set(text)`.
    HeapStr& operator=(char const* text);

    /// Stores a measured text; null gives the empty string.
    HeapStr& set(char const* text);
    /// Stores exactly n bytes in a block of exactly n + 1: the present block if its capacity is n, otherwise a new one.
    /// For n = 0 and for null the block is released.
    HeapStr& set(char const* text, std::uint64_t n);
    /// Releases the block and views the shared empty text.
    HeapStr& clear() noexcept;
    /// Removes the last byte, if there is one; the block does not change.
    HeapStr& cut() noexcept;
    /// Cuts the text to n bytes; a shorter text is only terminated again at its size. The block does not change.
    HeapStr& cut(std::uint64_t n) noexcept;
    /// Changes all bytes by the runtime's `tolower` and `toupper`.
    HeapStr& toLower() noexcept;
    HeapStr& toUpper() noexcept;

    /// Compare with a `std::string_view` by the rules of `std::string`.
    template <detail::StringView View>
    friend bool operator==(HeapStr const& a, View b) noexcept {
        return detail::sameAsView(a, b);
    }
    template <detail::StringView View>
    friend bool operator==(View a, HeapStr const& b) noexcept {
        return detail::viewSameAs(a, b);
    }
    template <detail::StringView View>
    friend std::weak_ordering operator<=>(HeapStr const& a, View b) noexcept {
        return detail::compareWithView(a.text_, b) <=> 0;
    }

protected:
    /// Allocates a block of n + 1 bytes and sets size and capacity to n. Releases nothing and writes no terminator.
    void alloc(std::uint64_t n);
    /// The work of a constructor: `set` without regard to an old block.
    void copy(char const* text, std::uint64_t n);
    void reassign(char const* text, std::uint64_t n);
    /// Views the shared empty text with size 0; the capacity does not change.
    void setEmpty() noexcept;
    /// Releases the text.
    void free() noexcept;

    /// The number of bytes of text that the block can hold; 0 if and only if the text is the shared empty one.
    std::uint64_t capacity_;

private:
    char* buffer() noexcept { return const_cast<char*>(text_); }
    bool hasBlock() const noexcept { return capacity_ > 0 && text_ != StrEmpty; }
};

template <>
inline constexpr bool detail::IS_TEXT<HeapStr> = true;

static_assert(sizeof(HeapStr) == 24);

} // namespace ZOR_Basis

template <>
struct std::hash<ZOR_Basis::HeapStr> : std::hash<ZOR_Basis::Str> {};

#endif

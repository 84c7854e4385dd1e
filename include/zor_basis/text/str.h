/// \file
/// `Str`: a read-only view of narrow text.
///
/// Every text parameter in the library is a `Str const&`. A view is two words and owns nothing: the text must outlive
/// it. It is also the base of the owning strings, which keep their text zero-terminated.
///
/// **Lengths.** If a text is a source, as (text, length), as a `Str` or as a `std::string`, a length of 0 means
/// "measure it": up to the terminator. A null text, or one whose first byte is the terminator, is an empty source
/// whatever its length. `HeapStr` is the exception: it uses every length as given.
///
/// **Comparing.** `==` regards sizes, ordering does not; the two may disagree about texts with inner zeros and about
/// views of parts of a text. A null text compares as the empty one. All six comparisons exist with `char const*` and
/// `std::string` on either side, and between all narrow text types. They compare texts, never addresses, also through
/// `std::less<>` and `std::ranges::less`, so a container can be searched for a literal without constructing a string:
///
///     std::map<BufStr<15>, int, std::less<>> trays{{"tray1", 500}, {"tray2", 250}};
///     bool const known = trays.contains("tray2");
///
/// **As a pointer.** A text converts to `char const*`, so the language treats it as one in a condition: `if (name)`
/// tests the pointer, which is not null for an empty text. The compiler therefore warns; call `some()` or `empty()`, or
/// compare `c_str()` with null. `delete name` and comparisons with pointers to anything but text do not compile.
///
/// **Standard views.** A `std::string_view` does not convert to a `Str`, because it need not be terminated. The owning
/// strings can be constructed from it, and a `Str` converts to it explicitly.

#ifndef ZOR_BASIS_TEXT_STR_H
#define ZOR_BASIS_TEXT_STR_H

#include "zor_basis/export.h"
#include "zor_basis/ground/hashing.h"
#include "zor_basis/text/char_ops.h"
#include "zor_basis/text/pointer_guard.h"

#include <compare>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <type_traits>

namespace ZOR_Basis {

class ZB_API Str : public detail::PointerGuard<char> {
public:
    /// The one empty text that all views and strings share. It is never written or released, and is set before any code
    /// runs.
    static char const* const StrEmpty;

    /// Views the empty text.
    Str() noexcept : size_(0), text_(StrEmpty) {}

    /// Views a zero-terminated text and measures it.
    /// \param text  is zero-terminated; null gives the empty text
    Str(char const* text) noexcept
        : size_(text != nullptr ? detail::textLength(text) : 0), text_(text != nullptr ? text : StrEmpty) {}

    /// Stores pointer and size as given; nothing is measured.
    Str(char const* text, std::uint64_t size) noexcept : size_(size), text_(text) {}

    /// Views the text of a standard string with its size.
    Str(std::string const& text) noexcept : size_(text.size()), text_(text.c_str()) {}

    /// The number of bytes of text, without the terminator.
    std::uint64_t size() const noexcept { return size_; }
    /// The text, as it was given.
    char const* c_str() const noexcept { return text_; }
    operator char const*() const noexcept { return text_; }
    /// Tells whether the pointer is not null, like the conversion to a pointer.
    [[deprecated("tells whether there is a pointer, not whether there is text: ask some() or empty()")]] explicit
    operator bool() const noexcept {
        return text_ != nullptr;
    }
    /// The text with its size unchanged, including inner zeros.
    explicit operator std::string_view() const noexcept { return {text_, size_}; }
    /// Ask for the size alone.
    bool empty() const noexcept { return size_ == 0; }
    bool some() const noexcept { return size_ > 0; }

    /// The first byte; the terminator if the text is empty.
    char first() const noexcept { return *text_; }
    /// The last byte.
    /// \pre not empty
    char last() const noexcept { return text_[size_ - 1]; }
    /// The byte at an index, which is not checked.
    template <detail::Index I>
    char operator[](I index) const noexcept {
        return text_[static_cast<std::uint64_t>(index)];
    }

    /// The first occurrence in this text, both up to their terminators.
    /// \return a pointer into this text, or null; null for null
    char const* find(char const* text) const noexcept { return detail::findText(text_, text); }

    /// Tells whether this text begins with the prefix, whose size is used as given: a prefix of size 0 always matches.
    bool beginWith(Str const& prefix) const noexcept {
        return prefix.text_ == text_ || prefix.size_ == 0 ||
               detail::compareTextsUpTo(prefix.text_, text_, prefix.size_) == 0;
    }

    /// Tells whether the texts are equal.
    /// \kept text-01: the right-hand size alone selects the comparison. If it is not 0, both sizes must be equal, and
    ///     so must that many bytes, compared up to a common terminator. If it is 0, the two texts are compared up to
    ///     their terminators. So a view of 3 bytes of "abcdef" equals "abc", but differs from it if the right-hand view
    ///     has size 0
    /// \cost none if both point at the same text, which is always equal
    bool operator==(Str const& other) const noexcept { return eq(other.text_, other.size_); }
    bool operator==(std::string const& other) const noexcept { return eq(other.c_str(), other.size()); }
    /// Tells whether the texts are equal up to their terminators; this size is ignored.
    bool operator==(char const* other) const noexcept { return eq(other, 0); }
    bool operator!=(Str const& other) const noexcept { return !(*this == other); }
    bool operator!=(std::string const& other) const noexcept { return !(*this == other); }
    bool operator!=(char const* other) const noexcept { return !(*this == other); }

    /// The same with the operands exchanged; here the `Str` is the right-hand operand, whose size decides.
    friend bool operator==(char const* a, Str const& b) noexcept { return Str(a) == b; }
    friend bool operator==(std::string const& a, Str const& b) noexcept { return Str(a) == b; }
    friend bool operator!=(char const* a, Str const& b) noexcept { return !(a == b); }
    friend bool operator!=(std::string const& a, Str const& b) noexcept { return !(a == b); }

    /// `==` with the source (text, n), n being the right-hand size.
    bool eq(char const* text, std::uint64_t n = 0) const noexcept {
        if (text_ == text) return true;
        // kept text-01: callers compare parts of texts by giving the right-hand operand a size
        if (n != 0) return size_ == n && detail::sameTexts(text_, text, n);
        return detail::compareTexts(text_, text) == 0;
    }

    /// -1, 0 or 1: the order of the unsigned bytes up to the terminators. The same text gives 0.
    /// \kept text-02: sizes are ignored, so a view of a part of a text is ordered like the whole rest of that text
    int compare(Str const& other) const noexcept {
        if (text_ == other.text_) return 0;
        // kept text-02: ordering is by terminated texts, because sorted lists of views rely on it
        return signOf(detail::compareTexts(text_, size_, other.text_, other.size_));
    }
    int compare(char const* other) const noexcept {
        return text_ == other ? 0 : signOf(detail::compareTexts(text_, other));
    }
    /// The order of the first n unsigned bytes, as `strncmp` gives it; 0 for n = 0 and for the same text.
    int compare(char const* other, std::uint64_t n) const noexcept {
        return text_ == other ? 0 : detail::compareTextsUpTo(text_, other, n);
    }

    /// The order of `compare`, for both operand orders: `a > b` is `b < a`, `a <= b` is `!(b < a)`, `a >= b` is `!(a <
    /// b)`. Each is declared separately: the standard's function objects look for a function of exactly that name, and
    /// compare addresses if they find none and both operands convert to pointers.
    bool operator<(Str const& other) const noexcept { return compare(other) < 0; }
    bool operator>(Str const& other) const noexcept { return compare(other) > 0; }
    bool operator<=(Str const& other) const noexcept { return compare(other) <= 0; }
    bool operator>=(Str const& other) const noexcept { return compare(other) >= 0; }
    std::weak_ordering operator<=>(Str const& other) const noexcept { return compare(other) <=> 0; }
    bool operator<(std::string const& other) const noexcept { return compare(Str(other)) < 0; }
    bool operator>(std::string const& other) const noexcept { return compare(Str(other)) > 0; }
    bool operator<=(std::string const& other) const noexcept { return compare(Str(other)) <= 0; }
    bool operator>=(std::string const& other) const noexcept { return compare(Str(other)) >= 0; }
    std::weak_ordering operator<=>(std::string const& other) const noexcept { return compare(Str(other)) <=> 0; }
    bool operator<(char const* other) const noexcept { return compare(other) < 0; }
    bool operator>(char const* other) const noexcept { return compare(other) > 0; }
    bool operator<=(char const* other) const noexcept { return compare(other) <= 0; }
    bool operator>=(char const* other) const noexcept { return compare(other) >= 0; }
    std::weak_ordering operator<=>(char const* other) const noexcept { return compare(other) <=> 0; }
    friend bool operator<(std::string const& a, Str const& b) noexcept { return b > a; }
    friend bool operator>(std::string const& a, Str const& b) noexcept { return b < a; }
    friend bool operator<=(std::string const& a, Str const& b) noexcept { return b >= a; }
    friend bool operator>=(std::string const& a, Str const& b) noexcept { return b <= a; }
    friend bool operator<(char const* a, Str const& b) noexcept { return b > a; }
    friend bool operator>(char const* a, Str const& b) noexcept { return b < a; }
    friend bool operator<=(char const* a, Str const& b) noexcept { return b >= a; }
    friend bool operator>=(char const* a, Str const& b) noexcept { return b <= a; }
    friend std::weak_ordering operator<=>(char const* a, Str const& b) noexcept { return 0 <=> b.compare(a); }

    /// `hashDjb2` of the text: over the bytes before the terminator, whatever the size.
    std::uint64_t hash() const noexcept { return hashDjb2(text_, size_); }

    /// Changes n bytes in place by the runtime's `tolower` and `toupper`.
    static void ToLower(char* text, std::uint64_t n) noexcept;
    static void ToUpper(char* text, std::uint64_t n) noexcept;

    /// Tells whether a character is a hexadecimal digit of either case.
    static bool isHexDigit(char c) noexcept { return hexToDigit(c) >= 0; }
    /// 0 to 15 for a hexadecimal digit of either case, otherwise -1.
    static int hexToDigit(char c) noexcept {
        if (c >= '0' && c <= '9') return c - '0';
        if (c >= 'a' && c <= 'f') return c - 'a' + 10;
        if (c >= 'A' && c <= 'F') return c - 'A' + 10;
        return -1;
    }
    /// Writes the two lower-case hexadecimal digits of a byte, the high one first, and no terminator.
    static void ch2hex(char c, char* digits) noexcept;
    /// The byte that two hexadecimal digits represent.
    /// \kept text-03: a character that is not a digit counts as 255, and the result is taken modulo 256: "ZZ" is 0xEF,
    ///     "1Z" is 0x0F
    static char decodeHexChar(char const* digits) noexcept;

protected:
    /// The view.
    std::uint64_t size_;
    char const* text_;

private:
    static int signOf(int order) noexcept { return (order > 0) - (order < 0); }
};

static_assert(sizeof(Str) == 16);

namespace detail {

/// The narrow text types.
template <class>
inline constexpr bool IS_TEXT = false;
template <>
inline constexpr bool IS_TEXT<Str> = true;

template <class T>
inline constexpr bool IS_TEXT_POINTER = std::is_same_v<T, char const*> || std::is_same_v<T, char*>;

/// Two text types neither of which converts to a reference to the other.
template <class A, class B>
concept UnrelatedTexts = (IS_TEXT<A> && IS_TEXT_POINTER<B>) || (IS_TEXT_POINTER<A> && IS_TEXT<B>) ||
                         (IS_TEXT<A> && IS_TEXT<B> && !std::is_base_of_v<A, B> && !std::is_base_of_v<B, A>);

} // namespace detail

} // namespace ZOR_Basis

/// The standard's range functions require this before they compare two types: both can be viewed as a `Str`.
template <class A, class B, template <class> class AQualified, template <class> class BQualified>
requires ZOR_Basis::detail::UnrelatedTexts<A, B>
struct std::basic_common_reference<A, B, AQualified, BQualified> {
    using type = ZOR_Basis::Str;
};

/// Hashes the bytes before the terminator, at most `size` of them, as for all narrow text types, whose hashes agree.
template <>
struct std::hash<ZOR_Basis::Str> {
    std::size_t operator()(ZOR_Basis::Str const& text) const noexcept {
        return std::hash<std::string_view>()(
            {text.c_str(), ZOR_Basis::detail::textLengthUpTo(text.c_str(), text.size())});
    }
};

#endif

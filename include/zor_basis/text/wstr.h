/// \file
/// `WStr`: a read-only view of wide text, the counterpart of `Str` in 16-bit code units.
///
/// As for narrow text, a length of 0 in a source means "measure it", and a null or empty text is an empty source. `==`
/// with a length of 0 on the right compares whole texts, as in `Str`. Two things differ from `Str`: the order is
/// reversed (wide-01), and only the comparisons declared here exist. All others are deleted, also for `std::less<>` and
/// its like, because they would compare addresses. In conditions, in `delete` and with other pointers the rules of
/// `Str` apply.

#ifndef ZOR_BASIS_TEXT_WSTR_H
#define ZOR_BASIS_TEXT_WSTR_H

#include "zor_basis/export.h"
#include "zor_basis/text/char_ops.h"
#include "zor_basis/text/pointer_guard.h"
#include "zor_basis/wide_char.h"

#include <compare>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace ZOR_Basis {

class ZB_API WStr : public detail::PointerGuard<WChar> {
public:
    /// The number of bytes in a code unit.
    static constexpr std::uint64_t SizeWChar = 2;
    /// The one empty wide text that all views and strings share. It is never written or released.
    static WChar const* const StrEmpty;

    /// Views the empty text.
    WStr() noexcept : size_(0), text_(StrEmpty) {}
    /// Views a zero-terminated text and measures it.
    /// \param text  is zero-terminated; null gives the empty text
    WStr(WChar const* text) noexcept
        : size_(text != nullptr ? detail::textLength(text) : 0), text_(text != nullptr ? text : StrEmpty) {}
    /// Stores pointer and size as given; nothing is measured.
    WStr(WChar const* text, std::uint64_t size) noexcept : size_(size), text_(text) {}
    /// Views the text of a standard string with its size.
    WStr(std::basic_string<WChar> const& text) noexcept : size_(text.size()), text_(text.c_str()) {}

    /// The number of code units of text, without the terminator.
    std::uint64_t size() const noexcept { return size_; }
    /// The text, as it was given.
    WChar const* wstr() const noexcept { return text_; }
    operator WChar const*() const noexcept { return text_; }
    /// Tells whether the pointer is not null, like the conversion to a pointer.
    [[deprecated("tells whether there is a pointer, not whether there is text: ask empty()")]] explicit
    operator bool() const noexcept {
        return text_ != nullptr;
    }
    /// The text with its size unchanged, including inner zeros.
    explicit operator std::basic_string_view<WChar>() const noexcept { return {text_, size_}; }
    /// Asks for the size alone.
    bool empty() const noexcept { return size_ == 0; }
    /// The first unit; the terminator if the text is empty.
    WChar first() const noexcept { return *text_; }
    /// The last unit.
    /// \pre not empty
    WChar last() const noexcept { return text_[size_ - 1]; }
    /// The unit at an index, which is not checked.
    template <detail::Index I>
    WChar operator[](I index) const noexcept {
        return text_[static_cast<std::uint64_t>(index)];
    }

    /// Tells whether this text equals the source. If n is not 0, this size must be n, and n units must be equal,
    /// compared up to a common terminator. If n is 0, the two texts are compared up to their terminators. Two equal
    /// pointers are always equal texts.
    bool eq(WChar const* text, std::uint64_t n = 0) const noexcept {
        if (text_ == text) return true;
        if (n != 0) return size_ == n && detail::sameTexts(text_, text, n);
        return detail::compareTexts(text_, text) == 0;
    }
    /// The right-hand size alone selects the comparison, as for `Str`.
    bool operator==(WStr const& other) const noexcept { return eq(other.text_, other.size_); }
    bool operator==(WChar const* other) const noexcept { return eq(other, 0); }
    bool operator!=(WStr const& other) const noexcept { return !(*this == other); }
    bool operator!=(WChar const* other) const noexcept { return !(*this == other); }
    // The same with the operands exchanged; here the `WStr` is the right-hand operand, whose size decides.
    friend bool operator==(WChar const* a, WStr const& b) noexcept { return WStr(a) == b; }
    friend bool operator!=(WChar const* a, WStr const& b) noexcept { return !(a == b); }

    /// Returns -1 if the argument's text sorts before this one, 1 if after it, by unsigned code units up to the
    /// terminators.
    /// \kept wide-01: this is the reverse of `Str::compare`, and `<` and `>` follow it: `a < b` holds if b's text sorts
    ///     before a's
    int compare(WStr const& other) const noexcept { return compare(other.text_); }
    int compare(WChar const* other) const noexcept {
        if (text_ == other) return 0;
        // kept wide-01: the argument comes first; sorted wide lists depend on this direction
        int const order = detail::compareTexts(other, text_);
        return (order > 0) - (order < 0);
    }
    /// The order of the first n units, the argument first; 0 for n = 0 and for the same text.
    int compare(WChar const* other, std::uint64_t n) const noexcept {
        return text_ == other ? 0 : detail::compareTextsUpTo(other, text_, n);
    }
    bool operator<(WStr const& other) const noexcept { return compare(other) < 0; }
    bool operator>(WStr const& other) const noexcept { return compare(other) > 0; }

    // Without these declarations the language would compare the texts' addresses.
    bool operator<=(WStr const&) const = delete;
    bool operator>=(WStr const&) const = delete;
    bool operator<(WChar const*) const = delete;
    bool operator>(WChar const*) const = delete;
    bool operator<=(WChar const*) const = delete;
    bool operator>=(WChar const*) const = delete;
    friend bool operator<(WChar const*, WStr const&) = delete;
    friend bool operator>(WChar const*, WStr const&) = delete;
    friend bool operator<=(WChar const*, WStr const&) = delete;
    friend bool operator>=(WChar const*, WStr const&) = delete;
    std::weak_ordering operator<=>(WStr const&) const = delete;
    std::weak_ordering operator<=>(WChar const*) const = delete;
    friend std::weak_ordering operator<=>(WChar const*, WStr const&) = delete;

    /// The first occurrence in this text, both up to their terminators.
    /// \return a pointer into this text, or null; null for null
    WChar const* find(WStr const& text) const noexcept { return find(text.text_); }
    WChar const* find(WChar const* text) const noexcept { return detail::findText(text_, text); }

    /// The number of code units before the terminator; 0 for null.
    static std::uint64_t Len(WChar const* text) noexcept { return text != nullptr ? detail::textLength(text) : 0; }
    /// Change each unit up to the terminator by the runtime's `towlower` and `towupper`.
    static void toLower(WChar* text) noexcept;
    static void toUpper(WChar* text) noexcept;

protected:
    /// The view.
    std::uint64_t size_;
    WChar const* text_;
};

static_assert(sizeof(WStr) == 16);

} // namespace ZOR_Basis

/// Hashes the units before the terminator, at most `size` of them, as for all wide text types, whose hashes agree.
template <>
struct std::hash<ZOR_Basis::WStr> {
    std::size_t operator()(ZOR_Basis::WStr const& text) const noexcept {
        using View = std::basic_string_view<ZOR_Basis::WChar>;
        return std::hash<View>()(View(text.wstr(), ZOR_Basis::detail::textLengthUpTo(text.wstr(), text.size())));
    }
};

#endif

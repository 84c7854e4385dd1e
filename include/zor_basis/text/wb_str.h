/// \file
/// `WBStr`: a wide string that keeps up to 255 code units inside the object; the wide counterpart of `BufStr<255>`.
///
/// Assigning, appending, growing, inserting and replacing follow the rules of `BufStr` with code units instead of
/// bytes: text-04 to text-09 and text-12 also hold here. Two things differ: a virtual function allocates the blocks and
/// zeroes them, and text whose case changes while it is stored follows wide-03. A source may lie inside the string's
/// own text.
///
///     WBStr name(ZB_W("page"));
///     name += ZB_W("-7");

#ifndef ZOR_BASIS_TEXT_WB_STR_H
#define ZOR_BASIS_TEXT_WB_STR_H

#include "zor_basis/text/inline_text.h"
#include "zor_basis/text/wstr.h"

#include <concepts>
#include <cstdint>
#include <functional>

namespace ZOR_Basis {

#if defined(__GNUC__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wnon-virtual-dtor" // a WBStr is never deleted through a pointer to another class
#endif

class WBStr;
ZB_EXTERN_TEMPLATE detail::InlineText<WBStr, WChar, 255>;

ZB_INLINE_PARTS_BEGIN
class ZB_API WBStr : public WStr {
    using Text = detail::InlineText<WBStr, WChar, 255>;
    friend Text;

public:
    /// Empty, inside the object.
    WBStr() noexcept { Text::start(*this); }
    /// Copy a text, with the same result as assigning it to an empty string.
    WBStr(WChar const* text, std::uint64_t n = 0) noexcept { Text::make(*this, text, n); }
    WBStr(WStr const& text) noexcept { Text::make(*this, text.wstr(), text.size()); }
    WBStr(WBStr const& other) noexcept : WStr(other) { Text::makeOwned(*this, other.text_, other.size_); }
    ~WBStr() { Text::end(*this); }

    /// Assigns a copy of the text. Assigning the string itself or its own text pointer changes nothing.
    WBStr& operator=(WBStr const& other) {
        if (this != &other) Text::assignOwned(*this, other.text_, other.size_);
        return *this;
    }
    WBStr& operator=(WStr const& text) {
        if (this != &text) Text::assign(*this, text.wstr(), text.size());
        return *this;
    }
    WBStr& operator=(WChar const* text) {
        if (text != text_) Text::assign(*this, text, 0);
        return *this;
    }
    WBStr& copy(WChar const* text, std::uint64_t n = 0) {
        Text::assign(*this, text, n);
        return *this;
    }

    /// Appends a text; an empty source changes nothing.
    WBStr& add(WChar const* text, std::uint64_t n = 0) {
        Text::append(*this, text, n);
        return *this;
    }
    WBStr& add(WStr const& text) { return add(text.wstr(), text.size()); }
    WBStr& operator+=(WStr const& text) { return add(text); }
    WBStr& operator+=(WChar const* text) { return add(text); }
    /// Appends one code unit; 0 appends nothing.
    template <detail::Index C>
    WBStr& operator+=(C c) {
        Text::append(*this, static_cast<WChar>(c));
        return *this;
    }

    /// Inserts a text; a position behind the size has no effect. The units that follow move, including inner zeros.
    WBStr& insert(std::uint64_t pos, WChar const* text, std::uint64_t n = 0) {
        Text::insert(*this, pos, text, n);
        return *this;
    }
    WBStr& insert(std::uint64_t pos, WStr const& text) { return insert(pos, text.wstr(), text.size()); }
    /// Replaces `count` units, or as many as there are, by a text; a count of 0 inserts, and an empty source only
    /// removes. At the size the text is appended; a position behind the size has no effect.
    WBStr& replace(std::uint64_t pos, std::uint64_t count, WChar const* text, std::uint64_t n = 0) {
        Text::replace(*this, pos, count, text, n);
        return *this;
    }
    WBStr& replace(std::uint64_t pos, std::uint64_t count, WStr const& text) {
        return replace(pos, count, text.wstr(), text.size());
    }

    /// The unit at an index, for writing; the index is not checked.
    template <detail::Index I>
    WChar& operator[](I index) noexcept {
        return getBuf()[static_cast<std::uint64_t>(index)];
    }
    /// The unit at an index; 0 at the size and beyond.
    template <detail::Index I>
    WChar operator[](I index) const noexcept {
        auto const i = static_cast<std::uint64_t>(index);
        return i < size_ ? text_[i] : WChar();
    }

    /// The text for direct writing, capacity + 1 units; must be followed by `resize` or `setSize`.
    WChar* getBuf() noexcept { return Text::text(*this); }
    /// The capacity in code units: 255 inside the object, otherwise the block's; the terminator is not counted.
    std::uint64_t sizeBuf() const noexcept { return Text::capacity(*this); }
    /// Ensures a capacity of at least max(n, size + 1); keeps the text up to an inner terminator.
    WBStr& extendBuf(std::uint64_t n) {
        CopyIfTooLong(text_, n, size_);
        return *this;
    }
    /// Measures the text again after direct writes, then cuts it to n units; n = 0 sets no bound. First stores a
    /// terminator at the index of the capacity, as in text-10.
    WBStr& resize(std::uint64_t n = 0) noexcept {
        Text::resize(*this, n);
        return *this;
    }
    /// Sets the size to n and stores a terminator there.
    /// \pre n is at most the capacity; nothing is checked
    WBStr& setSize(std::uint64_t n) noexcept {
        Text::setSize(*this, n);
        return *this;
    }
    /// Empties the text; a block is kept.
    WBStr& clear() noexcept {
        Text::setSize(*this, 0);
        return *this;
    }
    /// Removes the last unit, if there is one.
    WBStr& cut() noexcept {
        Text::cutLast(*this);
        return *this;
    }
    /// Cuts the text to n units; a shorter text is only terminated again at its size.
    WBStr& cut(std::uint64_t n) noexcept {
        Text::cutTo(*this, n);
        return *this;
    }

    /// Changes all units up to the terminator by the runtime's `towlower` and `towupper`.
    WBStr& toLower() noexcept {
        WStr::toLower(getBuf());
        return *this;
    }
    WBStr& toUpper() noexcept {
        WStr::toUpper(getBuf());
        return *this;
    }
    /// Assign the text in the other case: n units of it, or all of it if n is 0. The units from a terminator on are
    /// zeros. Null gives the empty string.
    /// \kept wide-03: if the capacity is below n + 1, a block of n + 1 units replaces it, that is a capacity of n,
    ///     which the next text of n units replaces again
    WBStr& toLower(WChar const* text, std::uint64_t n = 0);
    WBStr& toUpper(WChar const* text, std::uint64_t n = 0);

    /// Increments the text as a number with digits a to z: "" becomes "a", "az" becomes "ba", "zz" becomes "aaa".
    WBStr& NextLatin() {
        NextLatin(*this, size_ != 0 ? size_ - 1 : 0);
        return *this;
    }
    /// The same from the unit at `pos` to the left; an empty string becomes "a", and a position behind the last unit
    /// has no effect.
    static void NextLatin(WBStr& text, std::uint64_t pos) { Text::nextLatin(text, pos); }

protected:
    /// Allocates a zeroed block of `count` units.
    virtual WChar* alloc(std::uint64_t count);
    /// Releases the block that holds the text.
    virtual void free();

    /// Checks the capacity whenever the text grows; see `BufStr`.
    bool CopyIfTooLong(WChar const* source, std::uint64_t need, std::uint64_t keep) {
        return Text::copyIfTooLong(*this, source, need, keep);
    }

private:
    using Change = void (*)(WChar*);
    WBStr& assignChanged(WChar const* text, std::uint64_t n, Change change);

    detail::TextArea<WChar, 255> area_;
};
ZB_INLINE_PARTS_END

#if defined(__GNUC__)
#pragma GCC diagnostic pop
#endif

static_assert(sizeof(WBStr) == 8 + 16 + 512);

} // namespace ZOR_Basis

template <>
struct std::hash<ZOR_Basis::WBStr> : std::hash<ZOR_Basis::WStr> {};

#endif

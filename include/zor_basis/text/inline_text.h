/// \file
/// The machinery of the strings that keep short text inside the object: `BufStr` and `WBStr`. Users have no need of it.
///
/// The owner has the fields `size_`, `text_` and `area_`. The text is in the area, or in a heap block whose capacity the
/// area then holds; comparing `text_` with the area tells which. Blocks come from the owner's `alloc` and go back through
/// its `free`. Short texts are handled here, in the caller's code; whatever needs a block is in the library.

#ifndef ZOR_BASIS_TEXT_INLINE_TEXT_H
#define ZOR_BASIS_TEXT_INLINE_TEXT_H

#include "zor_basis/text/char_ops.h"

#include <cstdint>

namespace ZOR_Basis::detail {

/// The inline area; in the heap state its first 8 bytes hold the capacity of the block.
template <class Char, std::uint64_t N>
union TextArea {
    Char text[N + 1];
    std::uint64_t capacity;
};

/// How a source of known length is copied into place.
struct MoveMeasured {
    template <class Char>
    static void copy(Char* target, Char const* source, std::uint64_t length) noexcept {
        moveText(target, source, length);
    }
};
struct StopAtTerminator {
    template <class Char>
    static void copy(Char* target, Char const* source, std::uint64_t length) noexcept {
        copyText(target, source, length);
    }
};

template <class Owner, class Char, std::uint64_t N>
class InlineText {
public:
    static Char* text(Owner& o) noexcept { return const_cast<Char*>(o.text_); }
    static bool isInline(Owner const& o) noexcept { return o.text_ == o.area_.text; }
    static std::uint64_t capacity(Owner const& o) noexcept { return isInline(o) ? N : o.area_.capacity; }

    static void setSize(Owner& o, std::uint64_t size) noexcept {
        o.size_ = size;
        text(o)[size] = Char();
    }
    static void start(Owner& o) noexcept {
        o.text_ = o.area_.text;
        setSize(o, 0);
    }
    static void end(Owner& o) noexcept {
        if (!isInline(o)) o.free();
    }

    /// Makes the text a copy of the source; a length of 0 is measured.
    static void assign(Owner& o, Char const* source, std::uint64_t length) {
        if (isNothing(source)) {
            setSize(o, 0);
        } else if (length != 0) {
            assignSome<StopAtTerminator>(o, source, length);
        } else {
            assignSome<MoveMeasured>(o, source, textLength(source));
        }
    }

    /// Appends a copy of the source; a length of 0 is measured.
    static void append(Owner& o, Char const* source, std::uint64_t length) {
        if (isNothing(source)) return;
        if (length != 0) {
            appendSome<StopAtTerminator>(o, source, length);
        } else {
            appendSome<MoveMeasured>(o, source, textLength(source));
        }
    }

    static void append(Owner& o, Char unit) {
        if (unit == Char()) return;
        if (o.size_ < capacity(o)) {
            text(o)[o.size_] = unit;
            setSize(o, o.size_ + 1);
        } else {
            appendInNewBlock(o, &unit, 1);
        }
    }

    static void cutLast(Owner& o) noexcept {
        if (o.size_ > 0) setSize(o, o.size_ - 1);
    }
    static void cutTo(Owner& o, std::uint64_t n) noexcept { setSize(o, n < o.size_ ? n : o.size_); }

    // What follows is compiled into the library.

    /// The capacity check: makes sure of a capacity of max(need, keep + 1), moving `keep` units of the source into a
    /// new block where there is not enough. \return whether it did
    static bool copyIfTooLong(Owner& o, Char const* source, std::uint64_t need, std::uint64_t keep);
    /// Makes the text exactly `length` units of the source, in a new block of that capacity unless the capacity is
    /// larger than the length.
    static void assignExactly(Owner& o, Char const* source, std::uint64_t length);
    static void assignInNewBlock(Owner& o, Char const* source, std::uint64_t length);
    static void appendInNewBlock(Owner& o, Char const* source, std::uint64_t length);
    static void resize(Owner& o, std::uint64_t n) noexcept;
    static void insert(Owner& o, std::uint64_t position, Char const* source, std::uint64_t length);
    static void replace(Owner& o, std::uint64_t position, std::uint64_t count, Char const* source,
                        std::uint64_t length);
    static void replaceTail(Owner& o, std::uint64_t position, Char const* source, std::uint64_t length);
    static void nextLatin(Owner& o, std::uint64_t position);

    /// Whether a place lies in the text's own area or block.
    static bool holds(Owner const& o, Char const* place) noexcept;

private:
    template <class Copier>
    static void assignSome(Owner& o, Char const* source, std::uint64_t length) {
        // kept text-04: assigning asks for one unit more than it needs; capacities that callers see depend on it
        if (length < capacity(o)) {
            Copier::copy(text(o), source, length);
            setSize(o, length);
        } else {
            assignInNewBlock(o, source, length);
        }
    }

    template <class Copier>
    static void appendSome(Owner& o, Char const* source, std::uint64_t length) {
        // kept text-05: appending uses the area to its last unit
        if (length <= capacity(o) - o.size_) {
            Copier::copy(text(o) + o.size_, source, length);
            setSize(o, o.size_ + length);
        } else {
            appendInNewBlock(o, source, length);
        }
    }

    static Char* allocate(Owner& o, std::uint64_t capacity);
    static Char* makeBlock(Owner& o, Char const* source, std::uint64_t capacity, std::uint64_t keep);
    static void adopt(Owner& o, Char* block, std::uint64_t capacity) noexcept;
    static void exchange(Owner& o, std::uint64_t position, std::uint64_t removed, Char const* source,
                         std::uint64_t length);
    static void exchangeInPlace(Owner& o, std::uint64_t position, std::uint64_t removed, Char const* source,
                                std::uint64_t length);
    static void exchangeInNewBlock(Owner& o, std::uint64_t position, std::uint64_t removed, Char const* source,
                                   std::uint64_t length, std::uint64_t newSize);
};

} // namespace ZOR_Basis::detail

#endif

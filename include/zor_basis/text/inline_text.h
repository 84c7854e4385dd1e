/// \file
/// The implementation shared by the strings that keep short text inside the object: `BufStr` and `WBStr`. Not meant for
/// users.
///
/// The owner has the members `size_`, `text_` and `area_`. The text lies in the area, or in a heap block whose capacity
/// is then stored in the area; comparing `text_` with the area tells which. The owner's `alloc` and `free` manage the
/// blocks. Short texts are handled inline in the caller's code; everything that needs a block is compiled into the
/// library.

#ifndef ZOR_BASIS_TEXT_INLINE_TEXT_H
#define ZOR_BASIS_TEXT_INLINE_TEXT_H

#include "zor_basis/text/char_ops.h"
#include "zor_basis/text/word_ops.h"

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
    static void copy(char* target, char const* source, std::uint64_t length) noexcept {
        copyGiven(target, source, length);
    }
    static void copy(WChar* target, WChar const* source, std::uint64_t length) noexcept {
        copyText(target, source, length);
    }
};
struct StopAtTerminatorOfOwned {
    static void copy(char* target, char const* source, std::uint64_t length) noexcept {
        copyOwned(target, source, length);
    }
    static void copy(WChar* target, WChar const* source, std::uint64_t length) noexcept {
        copyText(target, source, length);
    }
};

template <class Owner, class Char, std::uint64_t N>
class InlineText {
public:
    static Char* text(Owner& o) noexcept { return const_cast<Char*>(o.text_); }
    static bool isInline(Owner const& o) noexcept { return o.text_ == o.area_.text; }
#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wmaybe-uninitialized" // the capacity is there whenever the text is not in the area
#endif
    static std::uint64_t capacity(Owner const& o) noexcept { return isInline(o) ? N : o.area_.capacity; }
#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic pop
#endif

    static void setSize(Owner& o, std::uint64_t size) noexcept {
        o.size_ = size;
        text(o)[size] = Char();
    }
    static void start(Owner& o) noexcept {
        o.text_ = o.area_.text;
        setSize(o, 0);
    }
    /// The work of a constructor: assigns to an empty string.
    static void make(Owner& o, Char const* source, std::uint64_t length) {
        o.text_ = o.area_.text;
        assign(o, source, length);
    }
    static void makeOwned(Owner& o, Char const* source, std::uint64_t length) {
        o.text_ = o.area_.text;
        assignOwned(o, source, length);
    }
    static void end(Owner& o) noexcept {
        if (!isInline(o)) [[unlikely]]
            o.free();
    }

    /// Assigns a copy of the source; a length of 0 means "measure it".
    static void assign(Owner& o, Char const* source, std::uint64_t length) {
        if (isNothing(source)) [[unlikely]] {
            setSize(o, 0);
        } else if (length != 0) [[likely]] {
            assignSome<StopAtTerminator>(o, source, length);
        } else {
            assignSome<MoveMeasured>(o, source, textLength(source));
        }
    }

    /// The same for a text that another string owns, all of which may therefore be read.
    static void assignOwned(Owner& o, Char const* source, std::uint64_t length) {
        if (length == 0 || *source == Char()) [[unlikely]] {
            assign(o, source, length);
        } else {
            assignSome<StopAtTerminatorOfOwned>(o, source, length);
        }
    }

    /// Appends a copy of the source; a length of 0 means "measure it".
    static void append(Owner& o, Char const* source, std::uint64_t length) {
        if (isNothing(source)) return;
        if (length != 0) {
            appendSome<StopAtTerminator>(o, source, length);
        } else {
            appendSome<MoveMeasured>(o, source, textLength(source));
        }
    }

    static void append(Owner& o, Char unit) {
        if (unit == Char()) return; // kept text-09: callers append what may be a terminator without asking
        std::uint64_t const size = o.size_;
        if (hasRoom(o, size, 1)) {
            Char* target = text(o) + size;
            o.size_ = size + 1;
            target[0] = unit;
            target[1] = Char();
        } else {
            appendUnitInNewBlock(o, unit);
        }
    }

    static void cutLast(Owner& o) noexcept {
        if (o.size_ > 0) setSize(o, o.size_ - 1);
    }
    static void cutTo(Owner& o, std::uint64_t n) noexcept { setSize(o, n < o.size_ ? n : o.size_); }

    // The following functions are compiled into the library.

    /// Ensures a capacity of max(need, keep + 1): if the present one is too small, allocates a new block and copies
    /// `keep` units of the source.
    /// \return whether there is a new block
    static bool copyIfTooLong(Owner& o, Char const* source, std::uint64_t need, std::uint64_t keep);
    /// Makes the text exactly `length` units of the source, in a new block of that capacity unless the capacity is
    /// larger than the length.
    static void assignExactly(Owner& o, Char const* source, std::uint64_t length);
    static void assignInNewBlock(Owner& o, Char const* source, std::uint64_t length);
    static void appendInNewBlock(Owner& o, Char const* source, std::uint64_t length);
    static void appendUnitInNewBlock(Owner& o, Char unit);
    static void resize(Owner& o, std::uint64_t n) noexcept;
    static void insert(Owner& o, std::uint64_t position, Char const* source, std::uint64_t length);
    static void replace(Owner& o, std::uint64_t position, std::uint64_t count, Char const* source,
                        std::uint64_t length);
    static void replaceTail(Owner& o, std::uint64_t position, Char const* source, std::uint64_t length);
    static void nextLatin(Owner& o, std::uint64_t position);

    /// Tells whether an address lies in the text's own area or block.
    static bool holds(Owner const& o, Char const* place) noexcept;

private:
    /// Tells whether `length` units fit behind a text of `size` units. A block is never smaller than the area, so short
    /// texts need no look at the state.
    static bool hasRoom(Owner const& o, std::uint64_t size, std::uint64_t length) noexcept {
        if (length < N && size <= N - length) return true;
        return length <= capacity(o) - size;
    }

    template <class Copier>
    static void assignSome(Owner& o, Char const* source, std::uint64_t length) {
        // kept text-04: assigning asks for one unit more than it needs; capacities that callers see depend on it
        if (length < N || length < capacity(o)) [[likely]] {
            Char* target = text(o);
            o.size_ = length;
            Copier::copy(target, source, length);
            target[length] = Char();
        } else {
            assignInNewBlock(o, source, length);
        }
    }

    template <class Copier>
    static void appendSome(Owner& o, Char const* source, std::uint64_t length) {
        // kept text-05: appending uses the area to its last unit
        std::uint64_t const size = o.size_;
        if (hasRoom(o, size, length)) {
            Char* target = text(o) + size;
            o.size_ = size + length;
            Copier::copy(target, source, length);
            target[length] = Char();
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

/// \file
/// The parts of `InlineText` that need a block or run rarely. Instantiated once for each string class.

#ifndef BASIS_TEXT_INLINE_TEXT_IMPL_H
#define BASIS_TEXT_INLINE_TEXT_IMPL_H

#include "basis/text/held_text.h"
#include "zor_basis/text/inline_text.h"

#include <algorithm>
#include <cstdlib>
#include <limits>

namespace ZOR_Basis::detail {

inline constexpr std::uint64_t TOO_LONG = std::numeric_limits<std::uint64_t>::max();

inline std::uint64_t plus(std::uint64_t a, std::uint64_t b) noexcept { return a > TOO_LONG - b ? TOO_LONG : a + b; }

template <class Owner, class Char, std::uint64_t N>
bool InlineText<Owner, Char, N>::holds(Owner const& o, Char const* place) noexcept {
    auto const first = reinterpret_cast<std::uintptr_t>(o.text_);
    return reinterpret_cast<std::uintptr_t>(place) - first <= capacity(o) * sizeof(Char);
}

template <class Owner, class Char, std::uint64_t N>
inline Char* InlineText<Owner, Char, N>::allocate(Owner& o, std::uint64_t capacity) {
    Char* block = capacity != TOO_LONG ? o.alloc(capacity + 1) : nullptr;
    if (block == nullptr) std::abort();
    return block;
}

template <class Owner, class Char, std::uint64_t N>
inline Char* InlineText<Owner, Char, N>::makeBlock(Owner& o, Char const* source, std::uint64_t capacity,
                                                   std::uint64_t keep) {
    // kept text-08: callers rely on blocks being no larger than asked for
    Char* block = allocate(o, capacity);
    copyText(block, source, keep);
    block[keep] = Char();
    return block;
}

template <class Owner, class Char, std::uint64_t N>
inline void InlineText<Owner, Char, N>::adopt(Owner& o, Char* block, std::uint64_t capacity) noexcept {
    // kept text-07: the area holds the capacity from now on, so there is no way back into it
    end(o);
    o.text_ = block;
    o.area_.capacity = capacity;
}

template <class Owner, class Char, std::uint64_t N>
inline bool InlineText<Owner, Char, N>::copyIfTooLong(Owner& o, Char const* source, std::uint64_t need,
                                                      std::uint64_t keep) {
    std::uint64_t const required = std::max(need, plus(keep, 1));
    if (required <= capacity(o)) return false;
    adopt(o, makeBlock(o, source, required, keep), required);
    return true;
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::assignInNewBlock(Owner& o, Char const* source, std::uint64_t length) {
    std::uint64_t const capacity = plus(length, 1);
    adopt(o, makeBlock(o, source, capacity, length), capacity);
    o.size_ = length;
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::assignExactly(Owner& o, Char const* source, std::uint64_t length) {
    if (length < capacity(o)) {
        copyText(text(o), source, length);
    } else {
        adopt(o, makeBlock(o, source, length, length), length);
    }
    setSize(o, length);
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::appendInNewBlock(Owner& o, Char const* source, std::uint64_t length) {
    std::uint64_t const newSize = plus(o.size_, length);
    Char* block = makeBlock(o, o.text_, newSize, o.size_);
    copyText(block + o.size_, source, length);
    adopt(o, block, newSize);
    setSize(o, newSize);
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::appendUnitInNewBlock(Owner& o, Char unit) {
    appendInNewBlock(o, &unit, 1);
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::resize(Owner& o, std::uint64_t n) noexcept {
    // kept text-10: a buffer that was filled to the brim has no terminator of its own
    std::uint64_t const last = capacity(o);
    text(o)[last] = Char();
    setSize(o, textLengthUpTo(o.text_, n != 0 ? std::min(n, last) : last));
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::insert(Owner& o, std::uint64_t position, Char const* source, std::uint64_t length) {
    if (position == o.size_) return append(o, source, length);
    if (position < o.size_) exchange(o, position, 0, source, sourceLength(source, length));
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::replace(Owner& o, std::uint64_t position, std::uint64_t count, Char const* source,
                                         std::uint64_t length) {
    if (position == o.size_) return append(o, source, length);
    if (position > o.size_) return;
    std::uint64_t const removed = std::min(o.size_ - position, count);
    exchange(o, position, removed, source, sourceLength(source, length));
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::replaceTail(Owner& o, std::uint64_t position, Char const* source,
                                             std::uint64_t length) {
    std::uint64_t const taken = sourceLength(source, length);
    HeldText<Char> const held(source, holds(o, source) ? taken : 0);
    if (position < o.size_) setSize(o, position);
    if (taken != 0) append(o, held.orElse(source), taken);
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::exchange(Owner& o, std::uint64_t position, std::uint64_t removed, Char const* source,
                                          std::uint64_t length) {
    std::uint64_t const newSize = plus(o.size_ - removed, length);
    if (newSize <= capacity(o)) {
        exchangeInPlace(o, position, removed, source, length);
    } else {
        exchangeInNewBlock(o, position, removed, source, length, newSize);
    }
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::exchangeInPlace(Owner& o, std::uint64_t position, std::uint64_t removed,
                                                 Char const* source, std::uint64_t length) {
    HeldText<Char> const held(source, holds(o, source) ? length : 0);
    Char* place = text(o) + position;
    std::uint64_t const tail = o.size_ - position - removed;
    moveText(place + length, place + removed, tail);
    copyText(place, held.orElse(source), length);
    setSize(o, position + length + tail);
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::exchangeInNewBlock(Owner& o, std::uint64_t position, std::uint64_t removed,
                                                    Char const* source, std::uint64_t length, std::uint64_t newSize) {
    Char* block = allocate(o, newSize);
    moveText(block, o.text_, position);
    copyText(block + position, source, length);
    moveText(block + position + length, o.text_ + position + removed, o.size_ - position - removed);
    adopt(o, block, newSize);
    setSize(o, newSize);
}

template <class Owner, class Char, std::uint64_t N>
void InlineText<Owner, Char, N>::nextLatin(Owner& o, std::uint64_t position) {
    if (o.size_ == 0) return append(o, Char('a'));
    if (position >= o.size_) return;
    for (Char* digit = text(o) + position;; --digit) {
        // kept text-12: every character but "z" counts on, so names that contain other characters differ, too
        if (*digit != Char('z')) {
            ++*digit;
            return;
        }
        *digit = Char('a');
        if (digit == o.text_) return append(o, Char('a'));
    }
}

} // namespace ZOR_Basis::detail

#endif

/// \file
/// Two narrow texts side by side in vectors of 64 bytes, for processors with AVX-512BW.

#ifndef BASIS_TEXT_WIDE_TEXT_PAIR_H
#define BASIS_TEXT_WIDE_TEXT_PAIR_H

#include "basis/text/text_pair.h"

#include <cstdint>

#if ZB_WIDE_VECTOR_TEXT

namespace ZOR_Basis::detail {

using WidePlaces = Places<std::uint64_t>;

ZB_AVX512 ZB_INLINE WidePlaces placesOf(__m512i a, __m512i b) noexcept {
    std::uint64_t const different = _mm512_cmpneq_epi8_mask(a, b);
    return {different, different | zerosIn(a)};
}

/// Of 64 bytes.
ZB_AVX512 ZB_INLINE WidePlaces widePlaces(char const* a, char const* b) noexcept {
    return placesOf(load64(a), load64(b));
}

/// Of 1 to 64 bytes, behind which both texts look as if they ended.
ZB_AVX512 ZB_INLINE WidePlaces widePlaces(char const* a, char const* b, std::uint64_t length) noexcept {
    return placesOf(loadFirst(a, length), loadFirst(b, length));
}

/// What two texts are asked: whether they are the same, or for their order. `at` answers where they differ or end.
struct AreSame {
    using Answer = bool;
    static bool at(char const*, char const*, WidePlaces const& places) noexcept { return places.same(); }
    static bool atTheEnd(char const*, char const*) noexcept { return true; }
    static bool byRuntime(char const* a, char const* b, std::uint64_t length) noexcept {
        return sameByRuntime(a, b, length);
    }
};
struct OrderOf {
    using Answer = int;
    static int at(char const* a, char const* b, WidePlaces const& places) noexcept {
        return orderAt(a, b, places.first());
    }
    static int atTheEnd(char const* a, char const* b) noexcept { return orderAtTheEnd(a, b); }
    static int byRuntime(char const* a, char const* b, std::uint64_t) noexcept { return orderByRuntime(a, b); }
};

/// Two texts of more than 64 bytes. They go in runs of 64, of which the last begins in the one before, with a branch
/// for each: texts that differ mostly do so early.
template <class Text, class Question>
class WideRuns {
public:
    ZB_AVX512 ZB_INLINE WideRuns(char const* a, char const* b, std::uint64_t length) noexcept
        : a_(a), b_(b), length_(length) {}

    /// Whether there is an answer within the length.
    ZB_AVX512 ZB_INLINE bool areDecided() noexcept {
        if (isDecidedAt(0)) return true;
        if (length_ > 128) {
            if (isDecidedAt(64)) return true;
            for (std::uint64_t done = 128; length_ - done > 128; done += 64) {
                if (isDecidedAt(done)) return true;
            }
            if (isDecidedAt(length_ - 128)) return true;
        }
        return isDecidedAt(length_ - 64);
    }
    typename Question::Answer answer() const noexcept { return answer_; }

private:
    ZB_AVX512 ZB_INLINE bool isDecidedAt(std::uint64_t run) noexcept {
        char const* const a = a_ + run;
        char const* const b = b_ + run;
        if (!Text::readable(a, b, 64)) {
            answer_ = Question::byRuntime(a_, b_, length_);
            return true;
        }
        WidePlaces const places = widePlaces(a, b);
        if (places.decided == 0) return false;
        answer_ = Question::at(a, b, places);
        return true;
    }

    char const* a_;
    char const* b_;
    std::uint64_t length_;
    typename Question::Answer answer_ = {};
};

/// More than 64 bytes.
template <class Text, class Question>
ZB_AVX512 ZB_COLD typename Question::Answer askInWideRuns(char const* a, char const* b, std::uint64_t length) noexcept {
    WideRuns<Text, Question> runs(a, b, length);
    return runs.areDecided() ? runs.answer() : Question::atTheEnd(a + length, b + length);
}

/// 1 to 64 bytes that may be read.
ZB_AVX512 ZB_COLD inline int orderInOneRun(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const place = widePlaces(a, b, length).first();
    return place < length ? orderAt(a, b, place) : orderAtTheEnd(a + length, b + length);
}

} // namespace ZOR_Basis::detail

#endif

#endif

#include "basis/ground/processor.h"
#include "basis/text/vector_text.h"
#include "zor_basis/text/char_ops.h"
#include "zor_basis/text/word_ops.h"

#include <algorithm>

namespace ZOR_Basis::detail {

namespace {

/// A step at a time, for every source and every overlap.
template <class Char>
void copyUpToTerminator(Char* target, Char const* source, std::uint64_t length) noexcept {
    if (length == 0) return;
    std::uint64_t const copied = textLengthUpTo(source, length);
    std::memmove(target, source, copied * sizeof(Char));
    std::memset(target + copied, 0, (length - copied) * sizeof(Char));
}

} // namespace

#if ZB_VECTOR_TEXT

namespace {

/// How much of a text may be read before anything is known about its bytes.
struct Given {
    static bool readable(char const* text, std::uint64_t length) noexcept { return inOnePage(text, length); }
};
struct Owned {
    static bool readable(char const*, std::uint64_t) noexcept { return true; }
};

ZB_INLINE bool copyUpTo3(char* target, char const* source, std::uint64_t length) noexcept {
    if (length == 0) return true;
    char const first = source[0];
    char const middle = source[length / 2];
    char const last = source[length - 1];
    if (first == '\0' || middle == '\0' || last == '\0') return false;
    target[0] = first;
    target[length / 2] = middle;
    target[length - 1] = last;
    return true;
}

/// At most 64 bytes.
ZB_INLINE bool copyShort(char* target, char const* source, std::uint64_t length) noexcept {
    return copyInSteps<copyUpTo3>(target, source, length);
}

ZB_COLD void copyOther(char* target, char const* source, std::uint64_t length) noexcept {
    copyUpToTerminator(target, source, length);
}

#if ZB_WIDE_VECTOR_TEXT

bool overlap(char const* target, char const* source, std::uint64_t length) noexcept {
    auto const distance = static_cast<std::uint64_t>(target - source);
    return distance < length || 0 - distance < length;
}

ZB_AVX2 ZB_INLINE bool copy65To128(char* target, char const* source, std::uint64_t length) noexcept {
    __m256i const a = load32(source);
    __m256i const b = load32(source + 32);
    __m256i const c = load32(source + length - 64);
    __m256i const d = load32(source + length - 32);
    if (hasZero(_mm256_min_epu8(_mm256_min_epu8(a, b), _mm256_min_epu8(c, d)))) return false;
    store32(target, a);
    store32(target + 32, b);
    store32(target + length - 64, c);
    store32(target + length - 32, d);
    return true;
}

ZB_AVX2 ZB_INLINE bool copy129To256(char* target, char const* source, std::uint64_t length) noexcept {
    __m256i const a = load32(source);
    __m256i const b = load32(source + 32);
    __m256i const c = load32(source + 64);
    __m256i const d = load32(source + 96);
    __m256i const e = load32(source + length - 128);
    __m256i const f = load32(source + length - 96);
    __m256i const g = load32(source + length - 64);
    __m256i const h = load32(source + length - 32);
    __m256i const front = _mm256_min_epu8(_mm256_min_epu8(a, b), _mm256_min_epu8(c, d));
    __m256i const back = _mm256_min_epu8(_mm256_min_epu8(e, f), _mm256_min_epu8(g, h));
    if (hasZero(_mm256_min_epu8(front, back))) return false;
    store32(target, a);
    store32(target + 32, b);
    store32(target + 64, c);
    store32(target + 96, d);
    store32(target + length - 128, e);
    store32(target + length - 96, f);
    store32(target + length - 64, g);
    store32(target + length - 32, h);
    return true;
}

/// At most 256 bytes.
ZB_AVX2 ZB_INLINE bool copyReadable(char* target, char const* source, std::uint64_t length) noexcept {
    if (length > 128) [[likely]]
        return copy129To256(target, source, length);
    if (length > 64) return copy65To128(target, source, length);
    return copyShort(target, source, length);
}

/// At most 256 bytes, of which some may lie in the next page. Only a text that goes on there can be read there.
ZB_AVX2 ZB_COLD bool copyAcrossPages(char* target, char const* source, std::uint64_t length) noexcept {
    std::uint64_t const inPage =
        std::min(length, PAGE_BYTES - (reinterpret_cast<std::uintptr_t>(source) & (PAGE_BYTES - 1)));
    return !overlap(target, source, length) && copyReadable(target, source, inPage) &&
           copyReadable(target + inPage, source + inPage, length - inPage);
}

template <class Text>
ZB_AVX2 ZB_INLINE bool copyPart(char* target, char const* source, std::uint64_t length) noexcept {
    if (Text::readable(source, length)) [[likely]]
        return copyReadable(target, source, length);
    return copyAcrossPages(target, source, length);
}

/// In runs of 256 bytes, then the rest.
template <class Text>
ZB_AVX2 ZB_COLD void copyRuns(char* target, char const* source, std::uint64_t length) noexcept {
    if (overlap(target, source, length)) return copyOther(target, source, length);
    for (; length > 256; target += 256, source += 256, length -= 256) {
        if (!copyPart<Text>(target, source, 256)) return copyOther(target, source, length);
    }
    if (!copyPart<Text>(target, source, length)) copyOther(target, source, length);
}

/// More than 64 bytes, or not all of them readable.
template <class Text>
ZB_AVX2 ZB_COLD void copyLong(char* target, char const* source, std::uint64_t length) noexcept {
    if (length > 256) [[unlikely]]
        return copyRuns<Text>(target, source, length);
    if (!copyPart<Text>(target, source, length)) [[unlikely]]
        copyOther(target, source, length);
}

#endif

template <class Text>
ZB_INLINE void copyOf(char* target, char const* source, std::uint64_t length) noexcept {
    if (length <= 64 && Text::readable(source, length)) {
        if (copyShort(target, source, length)) return;
    } else {
#if ZB_WIDE_VECTOR_TEXT
        if (canUse(Vectors::AVX2)) [[likely]]
            return copyLong<Text>(target, source, length);
#endif
    }
    copyOther(target, source, length);
}

} // namespace

// kept text-06: the size is what the caller said, so the units behind the terminator have to be defined
void copyText(char* target, char const* source, std::uint64_t length) noexcept {
    copyOf<Given>(target, source, length);
}

void copyOwnedText(char* target, char const* source, std::uint64_t length) noexcept {
    copyOf<Owned>(target, source, length);
}

#else

void copyText(char* target, char const* source, std::uint64_t length) noexcept {
    copyUpToTerminator(target, source, length);
}

void copyOwnedText(char* target, char const* source, std::uint64_t length) noexcept {
    copyUpToTerminator(target, source, length);
}

#endif

void copyText(WChar* target, WChar const* source, std::uint64_t length) noexcept {
    copyUpToTerminator(target, source, length);
}

} // namespace ZOR_Basis::detail

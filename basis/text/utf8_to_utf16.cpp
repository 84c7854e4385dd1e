#include "basis/ground/processor.h"
#include "basis/text/utf.h"
#include "basis/text/utf8_block.h"
#include "basis/text/utf_characters.h"

#include <algorithm>
#include <cstring>

namespace ZOR_Basis::Utf {
namespace {

/// What is left to read, and the room that is left to write.
struct Progress {
    Byte const* text;
    Byte const* end;
    WChar* out;
    WChar* outEnd;

    std::uint64_t left() const { return static_cast<std::uint64_t>(end - text); }
    std::uint64_t room() const { return static_cast<std::uint64_t>(outEnd - out); }
    void advance(std::uint64_t bytes, std::uint64_t units) {
        text += bytes;
        out += units;
    }
};

Progress start(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
    auto const* const begin = reinterpret_cast<Byte const*>(text);
    return {begin, begin + size, out, out + room};
}

// ---- on every processor ---------------------------------------------------------------------------------------------

constexpr std::uint64_t ASCII_BYTES = 8;

bool areAscii(Byte const* text) {
    std::uint64_t word;
    std::memcpy(&word, text, sizeof word);
    return (word & 0x8080808080808080) == 0;
}

void takeAscii(Progress& progress) {
    while (std::min(progress.left(), progress.room()) >= ASCII_BYTES && areAscii(progress.text)) {
        std::copy_n(progress.text, ASCII_BYTES, progress.out);
        progress.advance(ASCII_BYTES, ASCII_BYTES);
    }
}

std::uint64_t toUtf16ByCharacters(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
    Progress progress = start(text, size, out, room);
    for (takeAscii(progress); progress.left() > 0; takeAscii(progress)) {
        auto const [character, bytes] = decode(progress.text, progress.left());
        if (bytes == 0) return INVALID;
        unsigned const units = utf16Units(character);
        if (units > progress.room()) return NO_ROOM;
        encode(character, progress.out);
        progress.advance(bytes, units);
    }
    return static_cast<std::uint64_t>(progress.out - out);
}

// ---- by blocks ------------------------------------------------------------------------------------------------------

#if ZB_VECTORS

/// Converts a block where there may be less room than storing a block touches.
/// \return the units; NO_ROOM
ZB_SSSE3 ZB_COLD std::uint64_t storeTight(__m128i before, __m128i block, unsigned places, WChar* out,
                                          std::uint64_t room) {
    WChar units[BLOCK_BYTES];
    std::uint64_t const size = storeUnits(Utf8Block(before, block), places, units);
    if (size > room) return NO_ROOM;
    std::memcpy(out, units, size * sizeof(WChar));
    return size;
}

/// \param count  the bytes of the block that belong to the text
/// \return whether its units fit
template <bool checked>
ZB_SSSE3 ZB_INLINE bool takeBlock(Progress& progress, Utf8Check& check, __m128i block, unsigned count) {
    __m128i const before = check.before;
    Utf8Block const taken = check.take<checked>(block);
    unsigned const places = bitsOf(taken.givesUnit()) & ((1U << count) - 1);
    std::uint64_t const size = progress.room() >= BLOCK_BYTES
                                   ? storeUnits(taken, places, progress.out)
                                   : storeTight(before, block, places, progress.out, progress.room());
    if (size == NO_ROOM) return false;
    progress.advance(count, size);
    return true;
}

/// Takes ASCII by two blocks, as long as they are nothing else.
ZB_AVX2 ZB_COLD std::uint64_t takeAsciiByAvx2(Byte const* text, WChar* out, std::uint64_t most) {
    constexpr std::uint64_t STEP = 2 * BLOCK_BYTES;
    std::uint64_t done = 0;
    for (; done + STEP <= most; done += STEP) {
        __m128i const low = load16(text + done);
        __m128i const high = load16(text + done + BLOCK_BYTES);
        if (bitsOf(_mm_or_si128(low, high)) != 0) break;
        store32(out + done, _mm256_cvtepu8_epi16(low));
        store32(out + done + BLOCK_BYTES, _mm256_cvtepu8_epi16(high));
    }
    return done;
}

/// Shorter texts do not repay what longer vectors cost to start.
constexpr std::uint64_t LEAST_WIDE_BYTES = 64;

/// Takes ASCII by blocks, as long as they are nothing else.
ZB_INLINE void takeAsciiBlocks(Progress& progress) {
    std::uint64_t const most = std::min(progress.left(), progress.room());
    std::uint64_t done = 0;
    if (most >= LEAST_WIDE_BYTES && detail::canUse(detail::Vectors::AVX2))
        done = takeAsciiByAvx2(progress.text, progress.out, most);
    for (; done + BLOCK_BYTES <= most; done += BLOCK_BYTES) {
        __m128i const block = load16(progress.text + done);
        if (bitsOf(block) != 0) break;
        store16(progress.out + done, lowUnits(block));
        store16(progress.out + done + BLOCK_UNITS, highUnits(block));
    }
    progress.advance(done, done);
}

/// Takes the end of a text of ASCII, less than a block. Some of it is stored twice, as the same units.
/// \pre the text has a block at least
ZB_INLINE void takeAsciiEnd(Progress& progress) {
    std::uint64_t const left = progress.left();
    __m128i const block = load16(progress.end - BLOCK_BYTES);
    if (bitsOf(block) != 0 || left > progress.room()) return;
    WChar* const out = progress.out + left - BLOCK_BYTES;
    store16(out, lowUnits(block));
    store16(out + BLOCK_UNITS, highUnits(block));
    progress.advance(left, left);
}

/// Takes blocks until ASCII begins again, less than a block is left, or one does not fit.
/// \return whether they fitted
template <bool checked>
ZB_SSSE3 ZB_INLINE bool takeBlocks(Progress& progress, Utf8Check& check) {
    while (progress.left() >= BLOCK_BYTES) {
        __m128i const block = load16(progress.text);
        if (bitsOf(block) == 0 && progress.room() >= BLOCK_BYTES) break;
        if (!takeBlock<checked>(progress, check, block, BLOCK_BYTES)) return false;
    }
    return true;
}

template <bool checked>
ZB_SSSE3 ZB_INLINE bool takeEnd(Progress& progress, Utf8Check& check, char const* text) {
    if (progress.left() == 0) return true;
    __m128i const block = lastUtf8Block(text, reinterpret_cast<char const*>(progress.end), progress.left());
    return takeBlock<checked>(progress, check, block, static_cast<unsigned>(progress.left()));
}

/// What follows a front of ASCII has a function of its own, so that ASCII pays for nothing else. It stays at SSSE3: the
/// compiler makes it slower for AVX2.
template <bool checked>
ZB_SSSE3 ZB_COLD std::uint64_t convertRest(char const* text, std::uint64_t size, WChar* out, std::uint64_t room,
                                           std::uint64_t front) {
    Progress progress = start(text, size, out, room);
    progress.advance(front, front);
    Utf8Check check;
    bool fits = takeBlocks<checked>(progress, check);
    while (fits && progress.left() >= BLOCK_BYTES) {
        check.takeAscii();
        takeAsciiBlocks(progress);
        fits = takeBlocks<checked>(progress, check);
    }
    fits = fits && takeEnd<checked>(progress, check, text);
    if (checked && !(fits ? check.isValidToTheEnd() : check.isValid())) return INVALID;
    return fits ? static_cast<std::uint64_t>(progress.out - out) : NO_ROOM;
}

template <bool checked>
ZB_INLINE std::uint64_t toUtf16ByBlocks(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
    Progress progress = start(text, size, out, room);
    takeAsciiBlocks(progress);
    if (size >= BLOCK_BYTES && progress.left() < BLOCK_BYTES) takeAsciiEnd(progress);
    return progress.left() == 0 ? size : convertRest<checked>(text, size, out, room, size - progress.left());
}

#endif

} // namespace

std::uint64_t toUtf16(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
#if ZB_VECTORS
    if (detail::canUse(detail::Vectors::SSSE3)) return toUtf16ByBlocks<true>(text, size, out, room);
#endif
    return toUtf16ByCharacters(text, size, out, room);
}

void validToUtf16(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
#if ZB_VECTORS
    if (detail::canUse(detail::Vectors::SSSE3)) {
        toUtf16ByBlocks<false>(text, size, out, room);
        return;
    }
#endif
    toUtf16ByCharacters(text, size, out, room);
}

} // namespace ZOR_Basis::Utf

#include "basis/ground/processor.h"
#include "basis/text/utf.h"
#include "basis/text/utf16_block.h"
#include "basis/text/utf_characters.h"

#include <algorithm>
#include <bit>
#include <cstring>

namespace ZOR_Basis::Utf {
namespace {

/// What is left to read, and the room that is left to write.
struct Progress {
    WChar const* begin;
    WChar const* text;
    WChar const* end;
    char* out;
    char* outEnd;
    bool hasZero = false;

    std::uint64_t done() const { return static_cast<std::uint64_t>(text - begin); }
    std::uint64_t left() const { return static_cast<std::uint64_t>(end - text); }
    std::uint64_t room() const { return static_cast<std::uint64_t>(outEnd - out); }
    void advance(std::uint64_t units, std::uint64_t bytes) {
        text += units;
        out += bytes;
    }
    Utf8Result result(char const* firstOut) const {
        return {done(), static_cast<std::uint64_t>(out - firstOut) & ~(std::uint64_t{1} << 63), hasZero};
    }
};

// ---- on every processor ---------------------------------------------------------------------------------------------

constexpr std::uint64_t ASCII_UNITS = 8;

bool areAscii(WChar const* text) {
    std::uint64_t words[2];
    std::memcpy(words, text, sizeof words);
    return ((words[0] | words[1]) & 0xFF80FF80FF80FF80) == 0;
}

void takeAscii(Progress& progress) {
    while (std::min(progress.left(), progress.room()) >= ASCII_UNITS && areAscii(progress.text)) {
        for (std::uint64_t i = 0; i < ASCII_UNITS; ++i) {
            progress.hasZero |= progress.text[i] == WChar();
            progress.out[i] = static_cast<char>(progress.text[i]);
        }
        progress.advance(ASCII_UNITS, ASCII_UNITS);
    }
}

/// \return whether the character fits
bool takeCharacter(Progress& progress) {
    auto const [character, units] = decode(progress.text, progress.left());
    unsigned const bytes = utf8Bytes(character);
    if (bytes > progress.room()) return false;
    progress.hasZero |= character == 0;
    encode(character, bytes, progress.out);
    progress.advance(units, bytes);
    return true;
}

Utf8Result toUtf8ByCharacters(WChar const* text, std::uint64_t size, char* out, std::uint64_t room) {
    Progress progress{text, text, text + size, out, out + room};
    do takeAscii(progress);
    while (progress.left() > 0 && takeCharacter(progress));
    return progress.result(out);
}

// ---- by blocks ------------------------------------------------------------------------------------------------------

#if ZB_VECTORS

constexpr std::uint64_t ASCII_STEP = 2 * BLOCK_UNITS;

/// How many units of two blocks are ASCII before the first other one.
ZB_INLINE unsigned asciiFront(__m128i low, __m128i high) {
    unsigned const ascii = bitsOf(_mm_packs_epi16(without(low, 0xFF80), without(high, 0xFF80)));
    return static_cast<unsigned>(std::countr_one(ascii));
}

struct AsciiRun {
    std::uint64_t units;
    bool hasZero;
};

/// Takes ASCII by four blocks, as long as they are nothing else.
ZB_AVX2 ZB_COLD AsciiRun takeAsciiByAvx2(WChar const* text, char* out, std::uint64_t most) {
    constexpr std::uint64_t STEP = 2 * ASCII_STEP;
    __m256i const beyondAscii = _mm256_set1_epi16(static_cast<short>(0xFF80));
    __m256i least = _mm256_set1_epi8(-1);
    std::uint64_t done = 0;
    for (; done + STEP <= most; done += STEP) {
        __m256i const low = load32(text + done);
        __m256i const high = load32(text + done + STEP / 2);
        if (_mm256_testz_si256(_mm256_or_si256(low, high), beyondAscii) == 0) break;
        // Packing takes the halves of both by turns.
        __m256i const bytes = _mm256_permute4x64_epi64(_mm256_packus_epi16(low, high), _MM_SHUFFLE(3, 1, 2, 0));
        least = _mm256_min_epu8(least, bytes);
        store32(out + done, bytes);
    }
    return {done, hasZero(least)};
}

/// Shorter texts do not repay what longer vectors cost to start.
constexpr std::uint64_t LEAST_WIDE_UNITS = 64;

/// Takes ASCII by two blocks, up to the first other unit.
ZB_INLINE void takeAsciiBlocks(Progress& progress) {
    std::uint64_t most = std::min(progress.left(), progress.room());
    if (most >= LEAST_WIDE_UNITS && detail::canUse(detail::Vectors::AVX2)) {
        auto const [units, hasZero] = takeAsciiByAvx2(progress.text, progress.out, most);
        progress.hasZero |= hasZero;
        progress.advance(units, units);
        most -= units;
    }
    __m128i least = eachUnit(-1);
    for (std::uint64_t steps = most / ASCII_STEP; steps > 0; --steps) {
        __m128i const low = load16(progress.text);
        __m128i const high = load16(progress.text + BLOCK_UNITS);
        __m128i const bytes = _mm_packus_epi16(low, high);
        store16(progress.out, bytes); // what is behind the front will be overwritten
        if (!isAscii(_mm_or_si128(low, high))) {
            unsigned const front = asciiFront(low, high);
            progress.hasZero |= (zerosIn(bytes) & ((1U << front) - 1)) != 0;
            progress.advance(front, front);
            break;
        }
        least = _mm_min_epu8(least, bytes);
        progress.advance(ASCII_STEP, ASCII_STEP);
    }
    progress.hasZero |= hasZero(least);
}

/// Takes the end of a text of ASCII, less than two blocks. Some of it is stored twice, as the same bytes.
/// \pre the text has two blocks at least
ZB_INLINE void takeAsciiEnd(Progress& progress) {
    std::uint64_t const left = progress.left();
    if (left > progress.room()) return;
    __m128i const low = load16(progress.end - ASCII_STEP);
    __m128i const high = load16(progress.end - BLOCK_UNITS);
    if (!isAscii(_mm_or_si128(low, high))) return;
    __m128i const bytes = _mm_packus_epi16(low, high);
    store16(progress.out + left - ASCII_STEP, bytes);
    progress.hasZero |= hasZero(bytes);
    progress.advance(left, left);
}

/// Converts a block where there may be less room than storing a block touches.
/// \return nothing if it does not fit
ZB_SSSE3 ZB_COLD Taken storeTight(__m128i block, unsigned count, char* out, std::uint64_t room) {
    char bytes[BLOCK_ROOM];
    Lengths const lengths(block);
    Taken const taken = storeUtf8(block, lengths, lengths.bits(), count, bytes);
    if (taken.bytes > room) return {};
    std::memcpy(out, bytes, taken.bytes);
    return taken;
}

/// \return whether the block fits
ZB_SSSE3 ZB_INLINE bool takeBlock(Progress& progress, __m128i block, Lengths const& lengths, unsigned bitsOfLengths,
                                  unsigned count) {
    Taken const taken = progress.room() >= BLOCK_ROOM ? storeUtf8(block, lengths, bitsOfLengths, count, progress.out)
                                                      : storeTight(block, count, progress.out, progress.room());
    progress.advance(taken.units, taken.bytes);
    return taken.units != 0;
}

/// Takes blocks until ASCII begins again, or less than a block is left.
/// \return whether the next two blocks begin with ASCII, and there is room for them
ZB_SSSE3 ZB_INLINE bool takeBlocks(Progress& progress) {
    bool isAsciiNext = false;
    __m128i zeros = _mm_setzero_si128();
    while (progress.left() >= BLOCK_UNITS) {
        __m128i const block = load16(progress.text);
        Lengths const lengths(block);
        unsigned const bits = lengths.bits();
        if (areAllOneOrTwo(bits) && !areAllOne(bits) && progress.room() >= BLOCK_BYTES) {
            // As `takeBlock` does, but a loop of this alone is a third faster.
            progress.advance(BLOCK_UNITS, storeShort(block, lengths, bits & 0xFF, progress.out));
        } else {
            isAsciiNext = areAllOne(bits) && std::min(progress.left(), progress.room()) >= ASCII_STEP;
            if (isAsciiNext || !takeBlock(progress, block, lengths, bits, BLOCK_UNITS)) break;
        }
        zeros = _mm_or_si128(zeros, zeroUnits(block));
    }
    progress.hasZero |= bitsOf(zeros) != 0;
    return isAsciiNext;
}

/// The last units, fewer than a block, with zeros behind them.
ZB_SSSE3 ZB_INLINE __m128i lastBlock(Progress const& progress) {
    std::uint64_t const left = progress.left();
    if (progress.end - progress.begin >= static_cast<std::ptrdiff_t>(BLOCK_UNITS))
        return movedToFront(load16(progress.end - BLOCK_UNITS), sizeof(WChar) * left);
    WChar window[BLOCK_UNITS] = {};
    std::memcpy(window, progress.text, left * sizeof(WChar));
    return load16(window);
}

ZB_SSSE3 ZB_INLINE void takeEnd(Progress& progress) {
    if (progress.left() == 0 || progress.left() >= BLOCK_UNITS) return;
    auto const left = static_cast<unsigned>(progress.left());
    __m128i const block = lastBlock(progress);
    Lengths const lengths(block);
    bool const hasZero = (bitsOf(zeroUnits(block)) & ((1U << 2 * left) - 1)) != 0;
    progress.hasZero |= takeBlock(progress, block, lengths, lengths.bits(), left) && hasZero;
}

/// What follows a front of ASCII has a function of its own, so that ASCII pays for nothing else.
ZB_SSSE3 ZB_COLD Utf8Result convertRest(WChar const* text, std::uint64_t size, char* out, std::uint64_t room,
                                        std::uint64_t front, bool hasZero) {
    Progress progress{text, text + front, text + size, out + front, out + room, hasZero};
    while (takeBlocks(progress)) takeAsciiBlocks(progress);
    takeEnd(progress);
    return progress.result(out);
}

ZB_INLINE Utf8Result toUtf8ByBlocks(WChar const* text, std::uint64_t size, char* out, std::uint64_t room) {
    Progress progress{text, text, text + size, out, out + room};
    takeAsciiBlocks(progress);
    if (size >= ASCII_STEP && progress.left() < ASCII_STEP) takeAsciiEnd(progress);
    if (progress.left() == 0) return progress.result(out);
    return convertRest(text, size, out, room, progress.done(), progress.hasZero);
}

#endif

} // namespace

Utf8Result toUtf8(WChar const* text, std::uint64_t size, char* out, std::uint64_t room) {
#if ZB_VECTORS
    if (detail::canUse(detail::Vectors::SSSE3)) return toUtf8ByBlocks(text, size, out, room);
#endif
    return toUtf8ByCharacters(text, size, out, room);
}

} // namespace ZOR_Basis::Utf

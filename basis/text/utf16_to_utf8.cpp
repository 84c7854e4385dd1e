#include "basis/text/utf.h"
#include "basis/text/utf_block.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>

namespace ZOR_Basis::Utf {
namespace {

constexpr std::uint32_t REPLACEMENT = 0xFFFD;
constexpr std::uint64_t LONGEST_CHARACTER = 4;

/// What is left to read, and the room that is left to write.
struct Progress {
    WChar const* begin;
    WChar const* text;
    WChar const* end;
    char* out;
    char* outEnd;
    bool hasZero = false; ///< whether a zero was among the units

    std::uint64_t done() const { return static_cast<std::uint64_t>(text - begin); }
    std::uint64_t left() const { return static_cast<std::uint64_t>(end - text); }
    std::uint64_t room() const { return static_cast<std::uint64_t>(outEnd - out); }
    void advance(std::uint64_t units, std::uint64_t bytes) {
        text += units;
        out += bytes;
    }
};

__m128i units(int value) { return _mm_set1_epi16(static_cast<short>(value)); }

__m128i zeroUnits(__m128i block) { return _mm_cmpeq_epi16(block, _mm_setzero_si128()); }

/// All ones in each unit that has none of the given bits.
__m128i without(__m128i block, int bits) { return zeroUnits(_mm_and_si128(block, units(bits))); }

bool isAscii(__m128i block) { return bitsOf(without(block, 0xFF80)) == 0xFFFF; }

__m128i packed(__m128i block) { return _mm_packus_epi16(block, block); }

// ---- whole blocks: ASCII, and characters of two bytes among it ------------------------------------------------------

constexpr Selection SHORTENED_UNITS = makeSelection(1, 2);

/// Stores a block of units up to 0x7FF, each as one byte or two. \return the bytes; 0 if there are greater units
ZB_SSSE3 inline unsigned storeMixedBlock(__m128i block, char* out) {
    if (bitsOf(without(block, 0xF800)) != 0xFFFF) return 0;
    __m128i const ascii = without(block, 0xFF80);
    __m128i const lead = _mm_srli_epi16(block, 6);
    __m128i const continuation = _mm_slli_epi16(_mm_and_si128(block, units(0x3F)), 8);
    __m128i const two = _mm_or_si128(_mm_or_si128(lead, continuation), units(0x80C0));
    __m128i const bytes = _mm_or_si128(_mm_and_si128(ascii, block), _mm_andnot_si128(ascii, two));
    return storeSelected(out, bytes, bitsOf(_mm_packs_epi16(ascii, ascii)) & 0xFF, SHORTENED_UNITS);
}

constexpr std::uint64_t LONG_BLOCK_BYTES = 3 * BLOCK_UNITS;
constexpr std::uint64_t LONG_BLOCK_ROOM = LONG_BLOCK_BYTES + 4; // what is stored beyond the block

/// Stores a block of units of three bytes each. \return whether it is one
ZB_SSSE3 inline bool storeLongBlock(__m128i block, char* out) {
    __m128i const high = _mm_and_si128(block, units(0xF800));
    if (bitsOf(_mm_or_si128(zeroUnits(high), _mm_cmpeq_epi16(high, units(0xD800)))) != 0) return false;
    __m128i const first = _mm_srli_epi16(block, 12);
    __m128i const second = _mm_and_si128(_mm_slli_epi16(block, 2), units(0x3F00));
    __m128i const front = _mm_or_si128(_mm_or_si128(first, second), units(0x80E0));
    __m128i const last = _mm_or_si128(_mm_and_si128(block, units(0x3F)), units(0x80));
    // Of each character's four bytes the last one goes.
    __m128i const kept = _mm_setr_epi8(0, 1, 2, 4, 5, 6, 8, 9, 10, 12, 13, 14, -1, -1, -1, -1);
    store16(out, _mm_shuffle_epi8(_mm_unpacklo_epi16(front, last), kept));
    store16(out + LONG_BLOCK_BYTES / 2, _mm_shuffle_epi8(_mm_unpackhi_epi16(front, last), kept));
    return true;
}

/// A block's last `left` units, moved to its front; zeros behind them.
ZB_SSSE3 inline __m128i movedToFront(__m128i block, std::uint64_t left) {
    static constexpr auto PLACES = [] {
        std::array<std::uint8_t, 2 * BLOCK_BYTES> places{};
        for (unsigned i = 0; i < places.size(); ++i) places[i] = static_cast<std::uint8_t>(i < BLOCK_BYTES ? i : 0x80);
        return places;
    }();
    return _mm_shuffle_epi8(block, load16(PLACES.data() + BLOCK_BYTES - sizeof(WChar) * left));
}

struct WithShuffle {
    ZB_SSSE3 static unsigned storeMixed(__m128i block, char* out) { return storeMixedBlock(block, out); }
    ZB_SSSE3 static bool storeLong(__m128i block, char* out) { return storeLongBlock(block, out); }
    ZB_SSSE3 static __m128i lastOf(__m128i block, std::uint64_t left) { return movedToFront(block, left); }
};
struct WithoutShuffle {
    ZB_INLINE static unsigned storeMixed(__m128i, char*) { return 0; }
    ZB_INLINE static bool storeLong(__m128i, char*) { return false; }
    ZB_INLINE static __m128i lastOf(__m128i block, std::uint64_t left) {
        WChar window[2 * BLOCK_UNITS] = {};
        store16(window, block);
        return load16(window + BLOCK_UNITS - left);
    }
};

ZB_INLINE void takeAsciiBlocks(Progress& progress) {
    constexpr std::uint64_t STEP = 2 * BLOCK_UNITS;
    __m128i least = _mm_set1_epi8(-1);
    for (std::uint64_t steps = std::min(progress.left(), progress.room()) / STEP; steps > 0; --steps) {
        __m128i const low = load16(progress.text);
        __m128i const high = load16(progress.text + BLOCK_UNITS);
        if (!isAscii(_mm_or_si128(low, high))) break;
        __m128i const bytes = _mm_packus_epi16(low, high);
        least = _mm_min_epu8(least, bytes);
        store16(progress.out, bytes);
        progress.advance(STEP, STEP);
    }
    progress.hasZero |= hasZero(least);
}

struct Run {
    std::uint64_t units;
    bool hasZero;
};

/// ASCII from the front of `most` units, by blocks of twice the size.
ZB_AVX2 Run takeWideAscii(WChar const* text, char* out, std::uint64_t most) {
    constexpr std::uint64_t STEP = 4 * BLOCK_UNITS;
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

/// Takes all of the text, if it is ASCII; else as much of its front as goes easily.
/// \pre nothing has been taken; at least a block
ZB_INLINE void takeAsciiText(Progress& progress) {
    if (progress.left() >= LEAST_WIDE_UNITS && ZB_HAS_AVX2) {
        auto const [units, hasZero] =
            takeWideAscii(progress.text, progress.out, std::min(progress.left(), progress.room()));
        progress.hasZero = hasZero;
        progress.advance(units, units);
    }
    takeAsciiBlocks(progress);
    // Two blocks reach from the end back to what has been taken; some of that is stored once more, where it is already.
    std::uint64_t const left = progress.left();
    if (left == 0 || left >= 2 * BLOCK_UNITS || progress.room() < left) return;
    std::uint64_t const back = std::min(progress.done() + left, 2 * BLOCK_UNITS);
    __m128i const low = load16(progress.end - back);
    __m128i const high = load16(progress.end - BLOCK_UNITS);
    if (!isAscii(_mm_or_si128(low, high))) return;
    char* const end = progress.out + left;
    store8(end - back, packed(low));
    store8(end - BLOCK_UNITS, packed(high));
    progress.hasZero |= bitsOf(_mm_or_si128(zeroUnits(low), zeroUnits(high))) != 0;
    progress.advance(left, left);
}

/// Takes blocks until one begins with a character that has to be taken by itself, or the text or the room nears its
/// end.
template <class Shuffle>
ZB_INLINE void takeBlocks(Progress& progress) {
    while (progress.left() >= BLOCK_UNITS && progress.room() >= BLOCK_BYTES) {
        __m128i const block = load16(progress.text);
        progress.hasZero |= bitsOf(zeroUnits(block)) != 0;
        unsigned const ascii = bitsOf(without(block, 0xFF80));
        unsigned const bytes = ascii != 0xFFFF ? Shuffle::storeMixed(block, progress.out) : 0;
        if (bytes != 0) {
            progress.advance(BLOCK_UNITS, bytes);
            continue;
        }
        store8(progress.out, packed(block));
        unsigned const front = static_cast<unsigned>(std::countr_one(ascii)) / 2;
        if (front < BLOCK_UNITS) {
            progress.advance(front, front);
            return;
        }
        progress.advance(BLOCK_UNITS, BLOCK_UNITS);
        takeAsciiBlocks(progress);
    }
}

/// The last units, fewer than a block, with zeros behind them.
template <class Shuffle>
ZB_INLINE __m128i lastBlock(Progress const& progress) {
    std::uint64_t const left = progress.left();
    if (progress.done() + left >= BLOCK_UNITS) return Shuffle::lastOf(load16(progress.end - BLOCK_UNITS), left);
    WChar window[BLOCK_UNITS] = {};
    std::memcpy(window, progress.text, left * sizeof(WChar));
    return load16(window);
}

/// Takes the text's last units, if there are fewer than a block of them and none is above 0x7FF.
template <class Shuffle>
ZB_INLINE void takeEnd(Progress& progress) {
    std::uint64_t const left = progress.left();
    if (left >= BLOCK_UNITS || left == 0 || progress.room() < BLOCK_BYTES) return;
    __m128i const block = lastBlock<Shuffle>(progress);
    unsigned bytes = BLOCK_UNITS;
    if (isAscii(block)) {
        store8(progress.out, packed(block));
    } else {
        bytes = Shuffle::storeMixed(block, progress.out);
        if (bytes == 0) return;
    }
    std::uint64_t const behind = BLOCK_UNITS - left;
    progress.hasZero |= (bitsOf(zeroUnits(block)) << sizeof(WChar) * behind & 0xFFFF) != 0;
    progress.advance(left, bytes - behind);
}

// ---- runs of longer characters, as in real text ---------------------------------------------------------------------

/// The three bytes of a unit above 0x7FF, the first one lowest.
std::uint32_t threeBytes(std::uint32_t unit) {
    return 0x8080E0u | unit >> 12 | (unit << 2 & 0x3F00) | (unit & 0x3F) << 16;
}

/// The four bytes of each surrogate pair in a word of one or two of them, the first one lowest.
template <class Word>
Word fourBytes(Word pairs) {
    constexpr Word EACH = static_cast<Word>(0x00000001'00000001);
    Word const high = (pairs & 0x3FF * EACH) + 0x40 * EACH; // the character without its lower ten bits
    Word const low = pairs >> 16 & 0x3FF * EACH;
    return 0x808080F0 * EACH | (high >> 8 & 0x07 * EACH) | (high & 0xFC * EACH) << 6 | (high & 0x03 * EACH) << 20 |
           (low & 0x3C0 * EACH) << 10 | (low & 0x3F * EACH) << 24;
}

/// Whether a word consists of surrogate pairs.
template <class Word>
bool arePairs(Word units) {
    constexpr Word EACH = static_cast<Word>(0x00000001'00000001);
    return (units & 0xFC00FC00 * EACH) == 0xDC00D800 * EACH;
}

__m128i eachLane(std::uint32_t value) { return _mm_set1_epi32(static_cast<int>(value)); }
__m128i lanesOf(__m128i block, std::uint32_t bits) { return _mm_and_si128(block, eachLane(bits)); }

/// The same of a block of four pairs.
__m128i fourBytes(__m128i pairs) {
    __m128i const high = _mm_add_epi32(lanesOf(pairs, 0x3FF), eachLane(0x40));
    __m128i const low = _mm_srli_epi32(pairs, 16);
    __m128i const first = lanesOf(_mm_srli_epi32(high, 8), 0x07);
    __m128i const second = _mm_slli_epi32(lanesOf(high, 0xFC), 6);
    __m128i const third =
        _mm_or_si128(_mm_slli_epi32(lanesOf(high, 0x03), 20), _mm_slli_epi32(lanesOf(low, 0x3C0), 10));
    __m128i const fourth = _mm_slli_epi32(lanesOf(low, 0x3F), 24);
    return _mm_or_si128(_mm_or_si128(_mm_or_si128(first, second), _mm_or_si128(third, fourth)), eachLane(0x808080F0));
}

bool arePairs(__m128i block) {
    return bitsOf(_mm_cmpeq_epi32(lanesOf(block, 0xFC00FC00), eachLane(0xDC00D800))) == 0xFFFF;
}

template <class Shuffle>
ZB_INLINE void takeThreeByteRun(Progress& progress) {
    while (progress.left() >= BLOCK_UNITS && progress.room() >= LONG_BLOCK_ROOM &&
           Shuffle::storeLong(load16(progress.text), progress.out)) {
        progress.advance(BLOCK_UNITS, LONG_BLOCK_BYTES);
    }
    // The word that is stored is one byte longer than the character.
    while (progress.left() > 0 && progress.room() >= LONGEST_CHARACTER) {
        std::uint32_t const unit = *progress.text;
        if (unit < 0x800 || isSurrogate(unit)) return;
        storeWord(progress.out, threeBytes(unit));
        progress.advance(1, 3);
    }
}

ZB_INLINE void takePairs(Progress& progress) {
    while (progress.left() >= BLOCK_UNITS && progress.room() >= BLOCK_BYTES) {
        __m128i const block = load16(progress.text);
        if (!arePairs(block)) break;
        store16(progress.out, fourBytes(block));
        progress.advance(BLOCK_UNITS, BLOCK_BYTES);
    }
    while (progress.left() >= 4 && progress.room() >= 2 * LONGEST_CHARACTER) {
        auto const word = loadWord<std::uint64_t>(progress.text);
        if (!arePairs(word)) return;
        storeWord(progress.out, fourBytes(word));
        progress.advance(4, 2 * LONGEST_CHARACTER);
    }
}

// ---- one character --------------------------------------------------------------------------------------------------

struct Encoded {
    std::uint32_t bytes; // the first one lowest
    unsigned length;
    unsigned units;
};

/// The character at the front of `size` units, U+FFFD for an unpaired surrogate.
Encoded encode(WChar const* text, std::uint64_t size) {
    std::uint32_t const unit = text[0];
    if (unit < 0x80) return {unit, 1, 1};
    if (unit < 0x800) return {0x80C0u | unit >> 6 | (unit & 0x3F) << 8, 2, 1};
    if (size > 1) {
        auto const word = loadWord<std::uint32_t>(text);
        if (arePairs(word)) return {fourBytes(word), 4, 2};
    }
    return {threeBytes(isSurrogate(unit) ? REPLACEMENT : unit), 3, 1};
}

/// \return whether the character fits
ZB_INLINE bool takeCharacter(Progress& progress) {
    Encoded const character = encode(progress.text, progress.left());
    if (character.length > progress.room()) return false;
    progress.hasZero |= *progress.text == WChar();
    std::memcpy(progress.out, &character.bytes, character.length);
    progress.advance(character.units, character.length);
    return true;
}

Utf8Text result(Progress const& progress, char const* out) {
    std::uint64_t const size = static_cast<std::uint64_t>(progress.out - out);
    return {progress.text == progress.end ? size : NO_ROOM, progress.hasZero};
}

/// Goes on to the end of the text, or of the room. \param front  how many units have been taken, all ASCII
template <class Shuffle>
ZB_INLINE Utf8Text takeRest(WChar const* text, std::uint64_t size, char* out, std::uint64_t room, std::uint64_t front,
                            bool hasZero) {
    Progress progress{text, text + front, text + size, out + front, out + room, hasZero};
    while (progress.text != progress.end) {
        takeBlocks<Shuffle>(progress);
        takeEnd<Shuffle>(progress);
        if (progress.text == progress.end) break;
        takeThreeByteRun<Shuffle>(progress);
        takePairs(progress);
        if (progress.text != progress.end && !takeCharacter(progress)) break;
    }
    return result(progress, out);
}

// These take words that fit registers: a whole `Progress` would have to be stored and waited for.
ZB_SSSE3 Utf8Text takeRestWithShuffle(WChar const* text, std::uint64_t size, char* out, std::uint64_t room,
                                      std::uint64_t front, bool hasZero) {
    return takeRest<WithShuffle>(text, size, out, room, front, hasZero);
}
Utf8Text takeRestWithoutShuffle(WChar const* text, std::uint64_t size, char* out, std::uint64_t room,
                                std::uint64_t front, bool hasZero) {
    return takeRest<WithoutShuffle>(text, size, out, room, front, hasZero);
}

ZB_INLINE Utf8Text convert(WChar const* text, std::uint64_t size, char* out, std::uint64_t room, bool canShuffle) {
    Progress progress{text, text, text + size, out, out + room};
    if (size >= BLOCK_UNITS) takeAsciiText(progress);
    if (progress.text == progress.end) return result(progress, out);
    return (canShuffle ? takeRestWithShuffle : takeRestWithoutShuffle)(text, size, out, room, progress.done(),
                                                                       progress.hasZero);
}

// ---- lengths --------------------------------------------------------------------------------------------------------

/// How far the bytes of the unit at `text[at]` fall short of three. A pair's six count as four.
unsigned savedAt(WChar const* text, std::uint64_t at, std::uint64_t size) {
    std::uint32_t const unit = text[at];
    if (unit < 0x80) return 2;
    if (unit < 0x800) return 1;
    return isHighSurrogate(unit) && at + 1 < size && isLowSurrogate(text[at + 1]) ? 2 : 0;
}

/// The same for eight units, negated. \pre a ninth unit
__m128i savedIn(WChar const* text) {
    __m128i const block = load16(text);
    __m128i const high = _mm_cmpeq_epi16(_mm_and_si128(block, units(0xFC00)), units(0xD800));
    __m128i const low = _mm_cmpeq_epi16(_mm_and_si128(load16(text + 1), units(0xFC00)), units(0xDC00));
    __m128i const pair = _mm_and_si128(high, low);
    return _mm_add_epi16(_mm_add_epi16(without(block, 0xFF80), without(block, 0xF800)), _mm_add_epi16(pair, pair));
}

} // namespace

std::uint64_t utf8Length(WChar const* text, std::uint64_t size) {
    constexpr std::uint64_t MOST_BLOCKS = 127; // at two a unit, more might overflow the byte that is summed
    std::uint64_t saved = 0;
    std::uint64_t done = 0;
    while (size - done > BLOCK_UNITS) {
        __m128i sums = _mm_setzero_si128();
        for (std::uint64_t blocks = std::min((size - done - 1) / BLOCK_UNITS, MOST_BLOCKS); blocks > 0; --blocks) {
            sums = _mm_sub_epi16(sums, savedIn(text + done));
            done += BLOCK_UNITS;
        }
        saved += sumOfBytes(sums);
    }
    for (; done < size; ++done) saved += savedAt(text, done, size);
    return 3 * size - saved;
}

Utf8Text toUtf8WithoutShuffle(WChar const* text, std::uint64_t size, char* out, std::uint64_t room) {
    return convert(text, size, out, room, false);
}

Utf8Text toUtf8(WChar const* text, std::uint64_t size, char* out, std::uint64_t room) {
    return convert(text, size, out, room, ZB_HAS_SSSE3);
}

} // namespace ZOR_Basis::Utf

#include "basis/text/utf.h"
#include "basis/text/utf_block.h"

#include <algorithm>
#include <bit>
#include <cstring>

namespace ZOR_Basis::Utf {
namespace {

using Byte = unsigned char;

/// What is left to read, and the room that is left to write.
struct Progress {
    Byte const* begin;
    Byte const* text;
    Byte const* end;
    WChar* out;
    WChar* outEnd;

    std::uint64_t done() const { return static_cast<std::uint64_t>(text - begin); }
    std::uint64_t left() const { return static_cast<std::uint64_t>(end - text); }
    std::uint64_t room() const { return static_cast<std::uint64_t>(outEnd - out); }
    void advance(std::uint64_t bytes, std::uint64_t units) {
        text += bytes;
        out += units;
    }
};

bool isContinuation(Byte byte) { return (byte & 0xC0) == 0x80; }

// ---- whole blocks: ASCII, and characters of two bytes among it ------------------------------------------------------

constexpr Selection CHOSEN_UNITS = makeSelection(2, 0);

__m128i lowUnits(__m128i bytes) { return _mm_unpacklo_epi8(bytes, _mm_setzero_si128()); }
__m128i highUnits(__m128i bytes) { return _mm_unpackhi_epi8(bytes, _mm_setzero_si128()); }

void storeAscii(__m128i block, WChar* out) {
    store16(out, lowUnits(block));
    store16(out + BLOCK_UNITS, highUnits(block));
}

/// The unit of each two-byte character at the place of its lead byte, ASCII as it is.
__m128i unitsOfTwo(__m128i bytes, __m128i next) {
    __m128i const isLead = _mm_cmpgt_epi16(bytes, _mm_set1_epi16(0xBF));
    __m128i const unit = _mm_or_si128(_mm_slli_epi16(_mm_and_si128(bytes, _mm_set1_epi16(0x1F)), 6),
                                      _mm_and_si128(next, _mm_set1_epi16(0x3F)));
    return _mm_or_si128(_mm_and_si128(isLead, unit), _mm_andnot_si128(isLead, bytes));
}

struct Taken {
    unsigned bytes;
    unsigned units;
};

/// Takes a block of ASCII and whole characters of two bytes, but not the first half of one at its end.
/// \return nothing if the block has others or a fault
ZB_SSSE3 inline Taken takeMixedBlock(__m128i block, WChar* out) {
    // As signed bytes, continuations are -128 to -65 and leads of two bytes -62 to -33.
    unsigned const continuations = bitsOf(_mm_cmplt_epi8(block, _mm_set1_epi8(-64)));
    unsigned const leads =
        bitsOf(_mm_and_si128(_mm_cmpgt_epi8(block, _mm_set1_epi8(-63)), _mm_cmplt_epi8(block, _mm_set1_epi8(-32))));
    if ((continuations | leads) != bitsOf(block) || continuations != (leads << 1 & 0xFFFF)) return {0, 0};
    unsigned const cut = leads >> (BLOCK_BYTES - 1);
    unsigned const starts = ~continuations & (0xFFFFu >> cut);
    __m128i const next = _mm_srli_si128(block, 1);
    unsigned size = storeSelected(out, unitsOfTwo(lowUnits(block), lowUnits(next)), starts & 0xFF, CHOSEN_UNITS) / 2;
    size +=
        storeSelected(out + size, unitsOfTwo(highUnits(block), highUnits(next)), starts >> BLOCK_UNITS, CHOSEN_UNITS) /
        2;
    return {static_cast<unsigned>(BLOCK_BYTES) - cut, size};
}

constexpr std::uint64_t LONG_CHARACTERS = 4;

/// Takes the four characters of three bytes that a block begins with. \return false if it does not
ZB_SSSE3 inline bool takeLongBlock(__m128i block, WChar* out) {
    __m128i const marks = _mm_setr_epi8(-16, -64, -64, -16, -64, -64, -16, -64, -64, -16, -64, -64, 0, 0, 0, 0);
    __m128i const marked =
        _mm_setr_epi8(-32, -128, -128, -32, -128, -128, -32, -128, -128, -32, -128, -128, 0, 0, 0, 0);
    if (bitsOf(_mm_cmpeq_epi8(_mm_and_si128(block, marks), marked)) != 0xFFFF) return false;
    // A lane for each character, its last byte lowest; then the six bits of each byte but the first are moved together.
    __m128i const lanes = _mm_shuffle_epi8(block, _mm_setr_epi8(2, 1, 0, -1, 5, 4, 3, -1, 8, 7, 6, -1, 11, 10, 9, -1));
    __m128i const payload = _mm_and_si128(lanes, _mm_set1_epi32(0x000F3F3F));
    __m128i const pairs = _mm_maddubs_epi16(payload, _mm_set1_epi32(0x00014001));
    __m128i const characters = _mm_madd_epi16(pairs, _mm_set1_epi32(0x10000001));
    __m128i const units =
        _mm_shuffle_epi8(characters, _mm_setr_epi8(0, 1, 4, 5, 8, 9, 12, 13, -1, -1, -1, -1, -1, -1, -1, -1));
    __m128i const high = _mm_and_si128(units, _mm_set1_epi16(static_cast<short>(0xF800)));
    __m128i const wrong = _mm_or_si128(_mm_cmpeq_epi16(high, _mm_setzero_si128()),
                                       _mm_cmpeq_epi16(high, _mm_set1_epi16(static_cast<short>(0xD800))));
    if ((bitsOf(wrong) & 0xFF) != 0) return false;
    store8(out, units);
    return true;
}

struct WithShuffle {
    ZB_SSSE3 static Taken takeMixed(__m128i block, WChar* out) { return takeMixedBlock(block, out); }
    ZB_SSSE3 static bool takeLong(__m128i block, WChar* out) { return takeLongBlock(block, out); }
};
struct WithoutShuffle {
    ZB_INLINE static Taken takeMixed(__m128i, WChar*) { return {0, 0}; }
    ZB_INLINE static bool takeLong(__m128i, WChar*) { return false; }
};

/// Takes blocks until one begins with a character that has to be taken by itself, or the text or the room nears its
/// end.
template <class Shuffle>
ZB_INLINE void takeBlocks(Progress& progress) {
    while (progress.left() >= BLOCK_BYTES && progress.room() >= BLOCK_BYTES) {
        __m128i const block = load16(progress.text);
        unsigned const beyondAscii = bitsOf(block);
        if (beyondAscii == 0) {
            storeAscii(block, progress.out);
            progress.advance(BLOCK_BYTES, BLOCK_BYTES);
            continue;
        }
        Taken taken = Shuffle::takeMixed(block, progress.out);
        if (taken.bytes == 0) {
            storeAscii(block, progress.out);
            unsigned const ascii = static_cast<unsigned>(std::countr_zero(beyondAscii));
            progress.advance(ascii, ascii);
            return;
        }
        progress.advance(taken.bytes, taken.units);
    }
}

/// The last bytes, fewer than a block, with zeros behind them.
ZB_INLINE __m128i lastBlock(Progress const& progress) {
    Byte window[2 * BLOCK_BYTES] = {};
    if (progress.done() < BLOCK_BYTES) {
        std::memcpy(window, progress.text, progress.left());
        return load16(window);
    }
    store16(window, load16(progress.end - BLOCK_BYTES));
    return load16(window + BLOCK_BYTES - progress.left());
}

/// Takes the text's last bytes, if there are fewer than a block of them and all are ASCII or characters of two bytes.
template <class Shuffle>
ZB_INLINE void takeEnd(Progress& progress) {
    std::uint64_t const left = progress.left();
    if (left >= BLOCK_BYTES || left == 0 || progress.room() < BLOCK_BYTES) return;
    __m128i const block = lastBlock(progress);
    if (bitsOf(block) == 0) {
        storeAscii(block, progress.out);
        progress.advance(left, left);
    } else if (Taken const taken = Shuffle::takeMixed(block, progress.out); taken.bytes != 0) {
        progress.advance(left, taken.units - (BLOCK_BYTES - left));
    }
}

// ---- runs of longer characters, as in real text: several in one step ------------------------------------------------

bool isThreeByteUnit(std::uint32_t unit) { return unit >= 0x800 && !isSurrogate(unit); }

/// The next bytes, six of them at least, the first one lowest. \pre eight bytes in all
ZB_INLINE std::uint64_t wordAt(Progress const& progress) {
    std::uint64_t const missing =
        sizeof(std::uint64_t) - std::min(progress.left(), std::uint64_t{sizeof(std::uint64_t)});
    return loadWord<std::uint64_t>(progress.text - missing) >> 8 * missing;
}

/// The unit of the three-byte character in the lower bytes of a word.
std::uint32_t threeByteUnit(std::uint64_t word) {
    return static_cast<std::uint32_t>((word & 0x0F) << 12 | (word >> 2 & 0xFC0) | (word >> 16 & 0x3F));
}

template <class Shuffle>
ZB_INLINE void takeThreeByteRun(Progress& progress) {
    while (progress.left() >= BLOCK_BYTES && progress.room() >= LONG_CHARACTERS &&
           Shuffle::takeLong(load16(progress.text), progress.out)) {
        progress.advance(3 * LONG_CHARACTERS, LONG_CHARACTERS);
    }
    while (progress.left() >= 6 && progress.done() + progress.left() >= sizeof(std::uint64_t) && progress.room() >= 2) {
        auto const word = wordAt(progress);
        std::uint32_t const first = threeByteUnit(word);
        std::uint32_t const second = threeByteUnit(word >> 24);
        if ((word & 0xC0C0F0'C0C0F0) != 0x8080E0'8080E0 || !isThreeByteUnit(first) || !isThreeByteUnit(second)) return;
        progress.out[0] = static_cast<WChar>(first);
        progress.out[1] = static_cast<WChar>(second);
        progress.advance(6, 2);
    }
}

WChar highSurrogate(std::uint32_t character) { return static_cast<WChar>(0xD7C0 + (character >> 10)); }
WChar lowSurrogate(std::uint32_t character) { return static_cast<WChar>(0xDC00 + (character & 0x3FF)); }

ZB_INLINE void takeFourByteRun(Progress& progress) {
    while (progress.left() >= sizeof(std::uint32_t) && progress.room() >= 2) {
        auto const word = loadWord<std::uint32_t>(progress.text);
        std::uint32_t const character =
            (word & 0x07) << 18 | (word << 4 & 0x3F000) | (word >> 10 & 0xFC0) | (word >> 24 & 0x3F);
        if ((word & 0xC0C0C0F8) != 0x808080F0 || character - 0x10000 > 0xFFFFF) return;
        progress.out[0] = highSurrogate(character);
        progress.out[1] = lowSurrogate(character);
        progress.advance(4, 2);
    }
}

// ---- one character --------------------------------------------------------------------------------------------------

struct Decoded {
    std::uint32_t character;
    unsigned bytes; // 0: invalid or cut off
};

Decoded decode(Byte const* text, std::uint64_t size) {
    std::uint32_t const lead = text[0];
    auto const rest = [text](unsigned i) { return static_cast<std::uint32_t>(text[i] & 0x3F); };
    if (lead < 0x80) return {lead, 1};
    if (lead < 0xE0) {
        if (lead < 0xC2 || size < 2 || !isContinuation(text[1])) return {};
        return {(lead & 0x1F) << 6 | rest(1), 2};
    }
    if (lead < 0xF0) {
        if (size < 3 || !isContinuation(text[1]) || !isContinuation(text[2])) return {};
        std::uint32_t const unit = (lead & 0x0F) << 12 | rest(1) << 6 | rest(2);
        return isThreeByteUnit(unit) ? Decoded{unit, 3} : Decoded{};
    }
    if (lead > 0xF4 || size < 4 || !isContinuation(text[1]) || !isContinuation(text[2]) || !isContinuation(text[3]))
        return {};
    std::uint32_t const character = (lead & 0x07) << 18 | rest(1) << 12 | rest(2) << 6 | rest(3);
    return character - 0x10000 <= 0xFFFFF ? Decoded{character, 4} : Decoded{};
}

/// \return 0; INVALID or NO_ROOM
ZB_INLINE std::uint64_t takeCharacter(Progress& progress) {
    auto const [character, bytes] = decode(progress.text, progress.left());
    if (bytes == 0) return INVALID;
    unsigned const units = character < 0x10000 ? 1 : 2;
    if (units > progress.room()) return NO_ROOM;
    if (units == 1) {
        progress.out[0] = static_cast<WChar>(character);
    } else {
        progress.out[0] = highSurrogate(character);
        progress.out[1] = lowSurrogate(character);
    }
    progress.advance(bytes, units);
    return 0;
}

template <class Shuffle>
ZB_INLINE std::uint64_t convert(Progress progress) {
    WChar const* const out = progress.out;
    while (progress.text != progress.end) {
        takeBlocks<Shuffle>(progress);
        takeThreeByteRun<Shuffle>(progress);
        takeFourByteRun(progress);
        takeEnd<Shuffle>(progress);
        if (progress.text == progress.end) break;
        std::uint64_t const failure = takeCharacter(progress);
        if (failure != 0) return failure;
    }
    return static_cast<std::uint64_t>(progress.out - out);
}

Progress start(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
    auto const* const begin = reinterpret_cast<Byte const*>(text);
    return {begin, begin, begin + size, out, out + room};
}

ZB_SSSE3 std::uint64_t toUtf16WithShuffle(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
    return convert<WithShuffle>(start(text, size, out, room));
}

} // namespace

std::uint64_t utf16Length(char const* text, std::uint64_t size) {
    // Every byte but a continuation begins a character; one that begins four bytes makes two units.
    constexpr std::uint64_t MOST_BLOCKS = 127; // at two a byte, more might overflow the byte's sum
    std::uint64_t units = 0;
    std::uint64_t done = 0;
    while (size - done >= BLOCK_BYTES) {
        __m128i sums = _mm_setzero_si128();
        for (std::uint64_t blocks = std::min((size - done) / BLOCK_BYTES, MOST_BLOCKS); blocks > 0; --blocks) {
            __m128i const block = load16(text + done);
            __m128i const starts = _mm_cmpgt_epi8(block, _mm_set1_epi8(-65));
            __m128i const fourByteLeads = _mm_cmpeq_epi8(_mm_max_epu8(block, _mm_set1_epi8(-16)), block);
            sums = _mm_sub_epi8(_mm_sub_epi8(sums, starts), fourByteLeads);
            done += BLOCK_BYTES;
        }
        units += sumOfBytes(sums);
    }
    for (; done < size; ++done) {
        Byte const byte = static_cast<Byte>(text[done]);
        units += (isContinuation(byte) ? 0u : 1u) + (byte >= 0xF0 ? 1u : 0u);
    }
    return units;
}

std::uint64_t toUtf16WithoutShuffle(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
    return convert<WithoutShuffle>(start(text, size, out, room));
}

std::uint64_t toUtf16(char const* text, std::uint64_t size, WChar* out, std::uint64_t room) {
    return ZB_HAS_SSSE3 ? toUtf16WithShuffle(text, size, out, room) : toUtf16WithoutShuffle(text, size, out, room);
}

} // namespace ZOR_Basis::Utf

#include "basis/text/utf.h"

#include <emmintrin.h>

#include <bit>
#include <cstring>

namespace ZOR_Basis::Utf {
namespace {

constexpr std::uint64_t BLOCK = 16;
constexpr std::uint32_t REPLACEMENT = 0xFFFD;

using Byte = unsigned char;

__m128i load(void const* p) { return _mm_loadu_si128(static_cast<__m128i const*>(p)); }
void store(void* p, __m128i block) { _mm_storeu_si128(static_cast<__m128i*>(p), block); }

std::uint32_t load32(Byte const* p) {
    std::uint32_t word;
    std::memcpy(&word, p, sizeof word);
    return word;
}

bool isContinuation(Byte byte) { return (byte & 0xC0) == 0x80; }

// ---- from UTF-8 ----------------------------------------------------------------------------------------------------

/// Widens ASCII from the front, 16 bytes at a time. \return the bytes done
std::uint64_t widenAscii(Byte const* text, std::uint64_t size, WChar* out) {
    __m128i const zero = _mm_setzero_si128();
    std::uint64_t done = 0;
    for (; done + BLOCK <= size; done += BLOCK) {
        __m128i const block = load(text + done);
        if (_mm_movemask_epi8(block) != 0) break;
        store(out + done, _mm_unpacklo_epi8(block, zero));
        store(out + done + BLOCK / 2, _mm_unpackhi_epi8(block, zero));
    }
    return done;
}

/// One character that is not ASCII. \return its bytes, 0 if it is invalid or cut off
unsigned decode(Byte const* text, std::uint64_t size, std::uint32_t& character) {
    Byte const lead = text[0];
    if (lead < 0xE0) {
        if (lead < 0xC2 || size < 2 || !isContinuation(text[1])) return 0;
        character = (lead & 0x1Fu) << 6 | (text[1] & 0x3Fu);
        return 2;
    }
    if (lead < 0xF0) {
        if (size < 3 || !isContinuation(text[1]) || !isContinuation(text[2])) return 0;
        character = (lead & 0x0Fu) << 12 | (text[1] & 0x3Fu) << 6 | (text[2] & 0x3Fu);
        return character >= 0x800 && !isSurrogate(character) ? 3 : 0;
    }
    if (lead > 0xF4 || size < 4 || !isContinuation(text[1]) || !isContinuation(text[2]) || !isContinuation(text[3]))
        return 0;
    character = (lead & 0x07u) << 18 | (text[1] & 0x3Fu) << 12 | (text[2] & 0x3Fu) << 6 | (text[3] & 0x3Fu);
    return character >= 0x10000 && character <= 0x10FFFF ? 4 : 0;
}

WChar* putUtf16(std::uint32_t character, WChar* out) {
    if (character < 0x10000) {
        *out++ = static_cast<WChar>(character);
    } else {
        *out++ = static_cast<WChar>(0xD7C0 + (character >> 10));
        *out++ = static_cast<WChar>(0xDC00 + (character & 0x3FF));
    }
    return out;
}

// The runs below take whole stretches of one kind of character, as real text has them: one test a character, four bytes
// read at once. Each leaves the first character that it does not take to `decode`.

struct Run {
    Byte const* text;
    Byte const* end;
    WChar* out;
};

void takeTwoByteRun(Run& run) {
    while (run.end - run.text >= 4) {
        std::uint32_t const word = load32(run.text);
        if ((word & 0xC0E0) != 0x80C0 || (word & 0x1E) == 0) return;
        *run.out++ = static_cast<WChar>((word & 0x1F) << 6 | (word >> 8 & 0x3F));
        if ((word & 0xC0E00000) != 0x80C00000 || (word & 0x1E0000) == 0) {
            run.text += 2;
            return;
        }
        *run.out++ = static_cast<WChar>((word >> 16 & 0x1F) << 6 | (word >> 24 & 0x3F));
        run.text += 4;
    }
}

void takeThreeByteRun(Run& run) {
    while (run.end - run.text >= 4) {
        std::uint32_t const word = load32(run.text);
        std::uint32_t const unit = (word & 0x0F) << 12 | (word >> 2 & 0xFC0) | (word >> 16 & 0x3F);
        if ((word & 0xC0C0F0) != 0x8080E0 || unit < 0x800 || isSurrogate(unit)) return;
        *run.out++ = static_cast<WChar>(unit);
        run.text += 3;
    }
}

void takeFourByteRun(Run& run) {
    while (run.end - run.text >= 4) {
        std::uint32_t const word = load32(run.text);
        std::uint32_t const character =
            (word & 0x07) << 18 | (word << 4 & 0x3F000) | (word >> 10 & 0xFC0) | (word >> 24 & 0x3F);
        if ((word & 0xC0C0C0F8) != 0x808080F0 || character - 0x10000 > 0xFFFFF) return;
        run.out = putUtf16(character, run.out);
        run.text += 4;
    }
}

void takeRun(Run& run) {
    Byte const lead = *run.text;
    if (lead < 0xE0) {
        takeTwoByteRun(run);
    } else if (lead < 0xF0) {
        takeThreeByteRun(run);
    } else {
        takeFourByteRun(run);
    }
}

} // namespace

std::uint64_t utf16Length(char const* text, std::uint64_t size) {
    // Every byte but a continuation begins a character; one that begins four bytes makes two units.
    std::uint64_t units = 0;
    std::uint64_t done = 0;
    for (; done + BLOCK <= size; done += BLOCK) {
        __m128i const block = load(text + done);
        int const starts = _mm_movemask_epi8(_mm_cmpgt_epi8(block, _mm_set1_epi8(-65)));
        int const fourByteLeads = _mm_movemask_epi8(_mm_cmpeq_epi8(_mm_max_epu8(block, _mm_set1_epi8(-16)), block));
        units += static_cast<unsigned>(std::popcount(static_cast<unsigned>(starts)) +
                                       std::popcount(static_cast<unsigned>(fourByteLeads)));
    }
    for (; done < size; ++done) {
        Byte const byte = static_cast<Byte>(text[done]);
        units += (isContinuation(byte) ? 0u : 1u) + (byte >= 0xF0 ? 1u : 0u);
    }
    return units;
}

std::uint64_t toUtf16(char const* text, std::uint64_t size, WChar* out) {
    Byte const* const begin = reinterpret_cast<Byte const*>(text);
    Run run{begin, begin + size, out};
    while (run.text != run.end) {
        if (*run.text < 0x80) {
            std::uint64_t const ascii = widenAscii(run.text, static_cast<std::uint64_t>(run.end - run.text), run.out);
            run.text += ascii;
            run.out += ascii;
            while (run.text != run.end && *run.text < 0x80) {
                *run.out++ = *run.text++;
                if (ascii == 0) break;
            }
            continue;
        }
        takeRun(run);
        if (run.text == run.end) break;
        if (*run.text < 0x80) continue;
        std::uint32_t character = 0;
        unsigned const bytes = decode(run.text, static_cast<std::uint64_t>(run.end - run.text), character);
        if (bytes == 0) return INVALID;
        run.out = putUtf16(character, run.out);
        run.text += bytes;
    }
    return static_cast<std::uint64_t>(run.out - out);
}

// ---- from UTF-16 ---------------------------------------------------------------------------------------------------

namespace {

constexpr std::uint64_t UNITS = BLOCK / sizeof(WChar);

/// The character at the front of `size` units, U+FFFD for an unpaired surrogate. \return its units
unsigned decode(WChar const* text, std::uint64_t size, std::uint32_t& character) {
    character = text[0];
    if (!isSurrogate(character)) return 1;
    if (isHighSurrogate(character) && size > 1 && isLowSurrogate(text[1])) {
        character = 0x10000 + ((character & 0x3FF) << 10) + (text[1] & 0x3FFu);
        return 2;
    }
    character = REPLACEMENT;
    return 1;
}

char* putUtf8(std::uint32_t character, char* out) {
    if (character < 0x80) {
        *out++ = static_cast<char>(character);
        return out;
    }
    if (character < 0x800) {
        *out++ = static_cast<char>(0xC0 | character >> 6);
    } else if (character < 0x10000) {
        *out++ = static_cast<char>(0xE0 | character >> 12);
        *out++ = static_cast<char>(0x80 | (character >> 6 & 0x3F));
    } else {
        *out++ = static_cast<char>(0xF0 | character >> 18);
        *out++ = static_cast<char>(0x80 | (character >> 12 & 0x3F));
        *out++ = static_cast<char>(0x80 | (character >> 6 & 0x3F));
    }
    *out++ = static_cast<char>(0x80 | (character & 0x3F));
    return out;
}

/// Narrows ASCII from the front, 16 units at a time. \return the units done
std::uint64_t narrowAscii(WChar const* text, std::uint64_t size, char* out) {
    __m128i const notAscii = _mm_set1_epi16(static_cast<short>(0xFF80));
    std::uint64_t done = 0;
    for (; done + 2 * UNITS <= size; done += 2 * UNITS) {
        __m128i const low = load(text + done);
        __m128i const high = load(text + done + UNITS);
        __m128i const rest = _mm_and_si128(_mm_or_si128(low, high), notAscii);
        if (_mm_movemask_epi8(_mm_cmpeq_epi16(rest, _mm_setzero_si128())) != 0xFFFF) break;
        store(out + done, _mm_packus_epi16(low, high));
    }
    return done;
}

unsigned bytesOf(std::uint32_t character) {
    return character < 0x80 ? 1 : character < 0x800 ? 2 : character < 0x10000 ? 3 : 4;
}

unsigned lanes(__m128i mask) {
    return static_cast<unsigned>(std::popcount(static_cast<unsigned>(_mm_movemask_epi8(mask)))) / 2;
}

} // namespace

std::uint64_t utf8Length(WChar const* text, std::uint64_t size) {
    __m128i const zero = _mm_setzero_si128();
    std::uint64_t bytes = 0;
    std::uint64_t done = 0;
    while (done < size) {
        if (done + UNITS <= size) {
            __m128i const block = load(text + done);
            __m128i const kind = _mm_and_si128(block, _mm_set1_epi16(static_cast<short>(0xF800)));
            if (lanes(_mm_cmpeq_epi16(kind, _mm_set1_epi16(static_cast<short>(0xD800)))) == 0) {
                __m128i const upTo7F =
                    _mm_cmpeq_epi16(_mm_and_si128(block, _mm_set1_epi16(static_cast<short>(0xFF80))), zero);
                bytes += 3 * UNITS - lanes(upTo7F) - lanes(_mm_cmpeq_epi16(kind, zero));
                done += UNITS;
                continue;
            }
        }
        // Up to the next block, so that a surrogate does not make every following unit go one by one twice.
        std::uint64_t const stop = done + UNITS < size ? done + UNITS : size;
        while (done < stop) {
            std::uint32_t character = 0;
            done += decode(text + done, size - done, character);
            bytes += bytesOf(character);
        }
    }
    return bytes;
}

std::uint64_t toUtf8(WChar const* text, std::uint64_t size, char* out) {
    char* const begin = out;
    std::uint64_t done = 0;
    while (done < size) {
        if (text[done] < 0x80) {
            std::uint64_t const ascii = narrowAscii(text + done, size - done, out);
            done += ascii;
            out += ascii;
            while (done < size && text[done] < 0x80) {
                *out++ = static_cast<char>(text[done++]);
                if (ascii == 0) break;
            }
            continue;
        }
        std::uint32_t character = 0;
        done += decode(text + done, size - done, character);
        out = putUtf8(character, out);
    }
    return static_cast<std::uint64_t>(out - begin);
}

} // namespace ZOR_Basis::Utf

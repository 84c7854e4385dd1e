#include "basis/text/utf.h"
#include "basis/text/utf16_long.h"
#include "basis/text/utf16_mixed.h"

#include <cstring>

namespace ZOR_Basis::Utf {

namespace {

constexpr std::uint32_t REPLACEMENT = 0xFFFD;
constexpr bool CANNOT_SHUFFLE = false;

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

} // namespace

Utf8Text toUtf8WithoutShuffle(WChar const* text, std::uint64_t size, char* out, std::uint64_t room) {
    return convert(text, size, out, room, CANNOT_SHUFFLE);
}

Utf8Text toUtf8(WChar const* text, std::uint64_t size, char* out, std::uint64_t room) {
    return convert(text, size, out, room, ZB_HAS_SSSE3);
}

} // namespace ZOR_Basis::Utf

/// \file
/// Random mixtures of all kinds of characters, and outputs for their conversion.

#ifndef TESTS_TEXT_RANDOM_UTF_H
#define TESTS_TEXT_RANDOM_UTF_H

#include "basis/text/utf.h"
#include "tests/support/random_steps.h"
#include "tests/text/reference_utf.h"

#include <algorithm>
#include <array>
#include <string>
#include <utility>
#include <vector>

namespace mixture {

inline constexpr std::uint32_t FIRST_OF_KIND[] = {0x00, 0x80, 0x800, 0x10000};
inline constexpr std::uint32_t LAST_OF_KIND[] = {0x7F, 0x7FF, 0xFFFF, 0x10FFFF};

using Source = std::mt19937_64;

inline std::uint64_t upTo(Source& source, std::uint64_t last) { return source() % (last + 1); }

inline std::uint32_t randomCharacter(Source& source, std::size_t kind) {
    std::uint32_t const first = FIRST_OF_KIND[kind];
    auto const character = static_cast<std::uint32_t>(first + upTo(source, LAST_OF_KIND[kind] - first));
    return ZOR_Basis::Utf::isSurrogate(character) ? character - 0x800 : character;
}

/// Runs of up to 20 characters of one kind, up to about 100 in all.
inline std::vector<std::uint32_t> randomText(Source& source) {
    std::vector<std::uint32_t> text;
    for (std::uint64_t size = upTo(source, 100); text.size() < size;) {
        std::size_t const kind = upTo(source, 3);
        for (std::uint64_t run = upTo(source, upTo(source, 1) == 0 ? 2 : 20); run > 0; --run)
            text.push_back(randomCharacter(source, kind));
    }
    return text;
}

/// An output that is followed by units that must not change.
template <class Char>
struct Output {
    static constexpr std::size_t BEHIND = 32;
    static constexpr Char UNTOUCHED = static_cast<Char>(0x5A);
    explicit Output(std::uint64_t room) : units(room + BEHIND, UNTOUCHED) {}
    bool keptBehind() const {
        return std::all_of(units.end() - BEHIND, units.end(), [](Char unit) { return unit == UNTOUCHED; });
    }
    std::basic_string<Char> text(std::uint64_t size) const { return {units.data(), size}; }
    std::vector<Char> units;
};

inline std::uint64_t someRoom(Source& source, std::uint64_t needed) {
    std::uint64_t const around = upTo(source, 2 * 20);
    return needed + around > 20 ? needed + around - 20 : 0;
}

/// The character of which a text consists, and the one that differs.
inline constexpr std::array<std::pair<std::uint32_t, std::uint32_t>, 10> PAIRS = {{{0x41, 0},
                                                                                   {0x41, 0xE9},
                                                                                   {0x41, 0x20AC},
                                                                                   {0x41, 0x1F600},
                                                                                   {0xE9, 0x41},
                                                                                   {0x20AC, 0x41},
                                                                                   {0x20AC, 0xE9},
                                                                                   {0x20AC, 0x1F600},
                                                                                   {0x1F600, 0x20AC},
                                                                                   {0x1F600, 0}}};

/// Calls `check` with each text of up to 80 equal characters of which one is replaced.
template <class Check>
void forOneAmongOthers(Check check) {
    for (auto const& [others, one] : PAIRS) {
        for (std::size_t size = 1; size <= 80; size += caseStride()) {
            for (std::size_t place = 0; place < size; ++place) {
                std::vector<std::uint32_t> text(size, others);
                text[place] = one;
                check(text);
            }
        }
    }
}

/// Calls `check` with texts that are longer than one round of the length's sums.
template <class Check>
void forLongTexts(Check check) {
    for (std::uint32_t character : {0x41u, 0xE9u, 0x20ACu, 0x1F600u})
        check(std::vector<std::uint32_t>(10'001, character));
}

} // namespace mixture

#endif

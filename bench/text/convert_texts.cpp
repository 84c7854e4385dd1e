#include "bench/text/convert_texts.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>
#include <memory>
#include <random>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace bench {

namespace {

constexpr std::size_t LARGEST = 65536;

// ---- characters -----------------------------------------------------------------------------------------------------

using Random = std::mt19937;

void addUtf8(std::string& text, char32_t character) {
    auto const add = [&text](char32_t byte) { text += static_cast<char>(byte); };
    if (character < 0x80) return add(character);
    if (character < 0x800) {
        add(0xC0 | character >> 6);
        return add(0x80 | (character & 0x3F));
    }
    if (character < 0x10000) {
        add(0xE0 | character >> 12);
    } else {
        add(0xF0 | character >> 18);
        add(0x80 | (character >> 12 & 0x3F));
    }
    add(0x80 | (character >> 6 & 0x3F));
    add(0x80 | (character & 0x3F));
}

void addUtf16(std::u16string& text, char32_t character) {
    if (character < 0x10000) {
        text += static_cast<char16_t>(character);
    } else {
        text += static_cast<char16_t>(0xD800 + ((character - 0x10000) >> 10));
        text += static_cast<char16_t>(0xDC00 + (character & 0x3FF));
    }
}

char32_t between(Random& random, char32_t first, char32_t last) {
    return std::uniform_int_distribution<std::uint32_t>(first, last)(random);
}

bool inPercent(Random& random, std::uint32_t share) {
    return std::uniform_int_distribution<std::uint32_t>(0, 99)(random) < share;
}

char32_t anyAscii(Random& random) { return between(random, 0x20, 0x7E); }

char32_t anyLatin(Random& random) {
    return inPercent(random, 70) ? between(random, 'a', 'z') : between(random, 0xC0, 0x17F);
}

char32_t anyCjk(Random& random) { return inPercent(random, 10) ? anyAscii(random) : between(random, 0x4E00, 0x9FFF); }

char32_t anyOfTheMix(Random& random) {
    if (inPercent(random, 50)) return anyAscii(random);
    return inPercent(random, 50) ? between(random, 0x4E00, 0x9FFF) : between(random, 0x1F300, 0x1F5FF);
}

std::u32string randomText(char32_t (*any)(Random&), std::uint32_t seed) {
    Random random(seed);
    std::u32string text(2 * LARGEST, U'\0');
    std::generate(text.begin(), text.end(), [&] { return any(random); });
    return text;
}

// ---- files ----------------------------------------------------------------------------------------------------------

std::string contentOf(char const* path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

std::string unpacked(char const* path) {
    std::string text;
    std::unique_ptr<std::FILE, int (*)(std::FILE*)> const pipe(
        popen(("gunzip -c " + std::string(path) + " 2>/dev/null").c_str(), "r"), pclose);
    char block[4096];
    while (std::size_t const size = pipe ? std::fread(block, 1, sizeof block, pipe.get()) : 0) text.append(block, size);
    return text;
}

std::uint32_t numberAt(std::string const& bytes, std::size_t offset) {
    std::uint32_t number = 0;
    if (offset + sizeof number > bytes.size()) throw std::runtime_error("a message catalogue ends early");
    std::memcpy(&number, bytes.data() + offset, sizeof number);
    return number;
}

/// All translations of a compiled message catalogue, each with a line feed behind it. The header's words: magic,
/// version, count, table of originals, table of translations; a table has length and offset of each text.
std::string translations(char const* path) {
    std::string const bytes = contentOf(path);
    std::string text;
    if (bytes.empty()) return text;
    std::uint32_t const count = numberAt(bytes, 8);
    std::uint32_t const table = numberAt(bytes, 16);
    for (std::uint32_t i = 1; i < count; ++i) {
        text += bytes.substr(numberAt(bytes, table + 8 * i + 4), numberAt(bytes, table + 8 * i)) + '\n';
    }
    // A text with plural forms has terminators between them.
    std::replace(text.begin(), text.end(), '\0', '\n');
    return text;
}

/// The characters of valid UTF-8.
std::u32string charactersOf(std::string const& text) {
    std::u32string characters;
    for (std::size_t i = 0; i < text.size();) {
        auto const lead = static_cast<unsigned char>(text[i]);
        std::size_t const length = lead < 0x80 ? 1 : lead < 0xE0 ? 2 : lead < 0xF0 ? 3 : 4;
        char32_t character = length == 1 ? lead : lead & (0x7F >> length);
        for (std::size_t k = 1; k < length && i + k < text.size(); ++k)
            character = character << 6 | (text[i + k] & 0x3F);
        characters += character;
        i += length;
    }
    return characters;
}

// ---- pools ----------------------------------------------------------------------------------------------------------

struct Size {
    char const* name;
    std::size_t bytes;
    /// So many that no predictor learns them, and that they stay in the second cache.
    std::size_t texts;
};

constexpr Size SIZES[] = {{"30B", 30, 512}, {"300B", 300, 64}, {"64KiB", LARGEST, 1}};

/// Cuts the next text of at most `bytes` bytes from the characters, which begin again at their end.
Text cut(std::u32string const& characters, std::size_t& at, std::size_t bytes) {
    Text text;
    std::string next;
    for (addUtf8(next, characters[at]); text.narrow.size() + next.size() <= bytes; addUtf8(next, characters[at])) {
        text.narrow += next;
        addUtf16(text.wide, characters[at]);
        at = (at + 1) % characters.size();
        next.clear();
    }
    return text;
}

void addPools(std::vector<Pool>& pools, std::string const& kind, std::u32string const& characters) {
    if (characters.empty()) {
        std::fprintf(stderr, "%s: the real text is not installed, its rows are left out\n", kind.c_str());
        return;
    }
    for (Size const& size : SIZES) {
        Pool pool{kind + "-" + size.name, {}};
        std::size_t at = 0;
        for (std::size_t i = 0; i < size.texts; ++i) pool.texts.push_back(cut(characters, at, size.bytes));
        pools.push_back(std::move(pool));
    }
}

} // namespace

std::vector<Pool> makePools() {
    std::vector<Pool> pools;
    addPools(pools, "ascii", randomText(anyAscii, 1));
    addPools(pools, "latin", randomText(anyLatin, 2));
    addPools(pools, "cjk", randomText(anyCjk, 3));
    addPools(pools, "mix", randomText(anyOfTheMix, 4));
    addPools(pools, "manual", charactersOf(unpacked("/usr/share/man/man1/bash.1.gz")));
    addPools(pools, "messages", charactersOf(translations("/usr/share/locale/ja/LC_MESSAGES/coreutils.mo")));
    addPools(pools, "emoji", charactersOf(contentOf("/usr/share/unicode/emoji/emoji-test.txt")));
    return pools;
}

} // namespace bench

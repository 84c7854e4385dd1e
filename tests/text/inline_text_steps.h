/// \file
/// Random operations on the strings with an inside area and on their model.

#ifndef TESTS_TEXT_INLINE_TEXT_STEPS_H
#define TESTS_TEXT_INLINE_TEXT_STEPS_H

#include "tests/support/operations.h"
#include "tests/text/string_kinds.h"
#include "tests/text/text_model.h"

#include <algorithm>
#include <cctype>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace inline_text {

using namespace ZOR_Basis;

/// A string, its model, and random sources for both.
/// \tparam Random  makes numbers like those of the standard library's random sources
template <class String_, class Random>
struct InlineTextBesideModel {
    using String = String_;
    using Char = CharOf<String>;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    using Source = ModelSource<Char>;
    static constexpr std::uint64_t N = Kind<String>::INSIDE;
    static constexpr bool NARROW = sizeof(Char) == 1;

    explicit InlineTextBesideModel(Random source) : random(std::move(source)) { makeEmpty(); }

    std::uint64_t below(std::uint64_t bound) { return random() % bound; }
    bool oneIn(std::uint64_t chances) { return below(chances) == 0; }

    Char unit() {
        if (oneIn(12)) return Char('z');
        if (oneIn(40)) return Char();
        if (oneIn(20)) return static_cast<Char>(0x80 + below(0x80));
        return static_cast<Char>('a' + below(26));
    }
    /// Mostly short, often close to the size of the inside area.
    std::uint64_t length() {
        switch (below(8)) {
        case 0:
            return below(N + N / 2 + 3);
        case 1:
            return N - 2 + below(5);
        case 2:
            return 0;
        default:
            return below(N / 3 + 2);
        }
    }
    Text text() {
        Text result(length(), Char());
        for (Char& c : result) c = unit();
        if (oneIn(3)) std::replace(result.begin(), result.end(), Char(), Char('q'));
        return result;
    }

    /// A source as the string and as the model receives it: text in a block of its own, null, or part of the string's
    /// own text.
    struct Given {
        Char const* pointer;
        Source model;
        std::unique_ptr<Char[]> block;
    };
    Given source() {
        if (oneIn(30)) return {nullptr, {{}, below(5)}, nullptr};
        std::uint64_t const given = oneIn(2) ? 0 : length();
        if (oneIn(5)) {
            std::uint64_t const from = below(model->content.size() + 1);
            return {static_cast<Char const*>(*string) + from, {model->content.substr(from), given}, nullptr};
        }
        Text const units = text();
        // Exactly large enough, so that a sanitizer sees every read beyond the end.
        std::uint64_t const size = std::min<std::uint64_t>(units.find(Char()), units.size()) + 1;
        auto block = std::make_unique<Char[]>(size);
        std::copy_n(units.c_str(), size, block.get());
        Char const* pointer = block.get();
        return {pointer, {units, given}, std::move(block)};
    }

    /// An index, mostly within the text, sometimes behind its end.
    std::uint64_t place() {
        std::uint64_t const size = model->content.size();
        return oneIn(8) ? size + below(3) : below(size + 1);
    }

    void makeEmpty() {
        string.emplace();
        model.emplace(N);
    }
    void makeOfText() {
        Text const units = text();
        string.emplace(units.c_str());
        model.emplace(N);
        model->assign({units, 0});
    }
    void makeOfView() {
        Text const units = text();
        std::uint64_t const given = length();
        string.emplace(View(units.c_str(), given));
        model.emplace(N);
        model->assign({units, given});
    }
    /// Replaces the string by its copy, in which only zeros follow the first zero.
    void makeOfItself() {
        String const copy(*string);
        Source const s{model->content, model->content.size()};
        string.emplace(copy);
        model.emplace(N);
        model->assign(s);
    }

    bool agree() const {
        String const& s = *string;
        Char const* held = s;
        return s.size() == model->content.size() && held[s.size()] == Char() &&
               std::char_traits<Char>::compare(held, model->content.data(), s.size()) == 0 &&
               s.sizeBuf() == model->capacity && isInside(s) == !model->onHeap;
    }

    Random random;
    std::optional<String> string;
    std::optional<TextModel<Char>> model;
};

template <class Both>
void copyText(Both& b) {
    auto const g = b.source();
    b.string->copy(g.pointer, g.model.length);
    b.model->assign(g.model);
}

template <class Both>
void assignText(Both& b) {
    auto const g = b.source();
    if (g.pointer == static_cast<typename Both::Char const*>(*b.string)) return;
    *b.string = g.pointer;
    b.model->assign({g.model.units, 0});
}

template <class Both>
void assignView(Both& b) {
    auto const g = b.source();
    *b.string = typename Both::View(g.pointer, g.model.length);
    b.model->assign(g.model);
}

template <class Both>
void assignString(Both& b) {
    auto const units = b.text();
    typename Both::String const other(units.c_str(), units.size());
    TextModel<typename Both::Char> otherModel(b.N);
    otherModel.assign({units, units.size()});
    *b.string = other;
    b.model->assign({otherModel.content, otherModel.content.size()});
}

template <class Both>
void assignItself(Both& b) {
    typename Both::String const& same = *b.string;
    *b.string = same;
    *b.string = static_cast<typename Both::View const&>(same);
    *b.string = static_cast<typename Both::Char const*>(same);
}

template <class Both>
void addText(Both& b) {
    auto const g = b.source();
    b.string->add(g.pointer, g.model.length);
    b.model->append(g.model);
}

template <class Both>
void addView(Both& b) {
    auto const g = b.source();
    *b.string += typename Both::View(g.pointer, g.model.length);
    b.model->append(g.model);
}

template <class Both>
void addItself(Both& b) {
    b.string->add(*b.string);
    b.model->append({typename Both::Text(b.model->content), b.model->content.size()});
}

template <class Both>
void addUnit(Both& b) {
    auto const c = b.unit();
    *b.string += c;
    b.model->append(c);
}

template <class Both>
void insert(Both& b) {
    std::uint64_t const place = b.place();
    auto const g = b.source();
    b.string->insert(place, g.pointer, g.model.length);
    b.model->insert(place, g.model);
}

template <class Both>
void replace(Both& b) {
    std::uint64_t const place = b.place();
    auto const g = b.source();
    std::uint64_t const count = b.oneIn(10) ? ~std::uint64_t{0} : b.below(b.model->content.size() + 3);
    b.string->replace(place, count, g.pointer, g.model.length);
    b.model->replace(place, count, g.model);
}

template <class Both>
void cutTo(Both& b) {
    std::uint64_t const place = b.place();
    b.string->cut(place);
    b.model->cut(place);
}

template <class Both>
void cut(Both& b) {
    b.string->cut();
    if (!b.model->content.empty()) b.model->cut(b.model->content.size() - 1);
}

template <class Both>
void clear(Both& b) {
    b.string->clear();
    b.model->content.clear();
}

template <class Both>
void extend(Both& b) {
    std::uint64_t const n = b.length();
    b.string->extendBuf(n);
    b.model->extend(n);
}

template <class Both>
void writeAndResize(Both& b) {
    auto units = b.text();
    std::uint64_t const most = b.model->capacity + 1;
    if (b.oneIn(4)) units.resize(most, 'w');
    if (units.size() > most) units.resize(most);
    std::copy(units.begin(), units.end(), b.string->getBuf());
    if (units.size() < most) b.string->getBuf()[units.size()] = 0;
    std::uint64_t const n = b.oneIn(2) ? 0 : b.length();
    b.string->resize(n);
    b.model->written(units, n);
}

template <class Both>
void writeOne(Both& b) {
    if (b.model->content.empty()) return;
    std::uint64_t const i = b.below(b.model->content.size());
    auto const c = b.oneIn(4) ? typename Both::Char() : b.unit();
    (*b.string)[i] = c;
    b.model->content[i] = c;
}

template <class Both>
void countOn(Both& b) {
    b.string->NextLatin();
    b.model->nextLatin();
}

template <class Both>
constexpr Operation<Both> INLINE_TEXT_OPERATIONS[] = {
    {"make an empty one", 1, [](auto& b) { b.makeEmpty(); }},
    {"make of a text", 1, [](auto& b) { b.makeOfText(); }},
    {"make of a view", 1, [](auto& b) { b.makeOfView(); }},
    {"make of itself", 1, [](auto& b) { b.makeOfItself(); }},
    {"copy", 8, copyText},
    {"assign a text", 8, assignText},
    {"assign a view", 8, assignView},
    {"assign a string", 8, assignString},
    {"assign itself", 8, assignItself},
    {"add a text", 16, addText},
    {"add a view", 8, addView},
    {"add itself", 8, addItself},
    {"add a unit", 16, addUnit},
    {"insert", 8, insert},
    {"replace", 8, replace},
    {"cut to a place", 8, cutTo},
    {"cut", 8, cut},
    {"clear", 8, clear},
    {"extend", 8, extend},
    {"write and resize", 8, writeAndResize},
    {"write one unit", 8, writeOne},
    {"count on", 8, countOn},
};

// ---- narrow strings -------------------------------------------------------------------------------------------------

template <class Both>
void replaceTail(Both& b) {
    std::uint64_t const place = b.place();
    auto const g = b.source();
    b.string->replaceTail(place, g.pointer, g.model.length);
    b.model->replaceTail(place, g.model);
}

template <class Both>
void streamNumber(Both& b) {
    int const number = static_cast<int>(b.random());
    *b.string << number;
    b.model->append({std::to_string(number), 0});
}

template <class Both>
void toUpper(Both& b) {
    b.string->toUpper();
    for (char& c : b.model->content) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
}

template <class Both>
void toHex(Both& b) {
    auto const g = b.source();
    std::string const units = g.pointer != nullptr ? g.model.units.substr(0, g.model.units.find('\0')) : "";
    b.string->toHex(g.pointer);
    b.model->content.clear();
    for (char c : units) {
        auto const byte = static_cast<unsigned char>(c);
        for (unsigned digit : {byte / 16U, byte % 16U}) b.model->append("0123456789abcdef"[digit]);
    }
}

inline unsigned valueOfDigit(char c) {
    auto const at = std::string_view("0123456789abcdefABCDEF").find(c);
    return at == std::string_view::npos ? 255U : static_cast<unsigned>(at > 15 ? at - 6 : at);
}

template <class Both>
void fromHex(Both& b) {
    auto const g = b.source();
    std::string const digits = g.model.units.substr(0, g.model.units.find('\0'));
    b.string->fromHex(g.pointer);
    for (std::size_t i = 0; i + 1 < digits.size(); i += 2) {
        unsigned const byte = 16 * valueOfDigit(digits[i]) + valueOfDigit(digits[i + 1]);
        b.model->append(static_cast<char>(static_cast<unsigned char>(byte)));
    }
}

template <class Both>
constexpr Operation<Both> NARROW_TEXT_OPERATIONS[] = {
    {"replace the tail", 1, replaceTail}, {"stream a number", 1, streamNumber},    {"upper", 1, toUpper},
    {"to hexadecimal digits", 1, toHex},  {"from hexadecimal digits", 1, fromHex},
};

template <class Both>
Operation<Both> const& drawnFor(Both& b) {
    if constexpr (Both::NARROW) {
        if (b.oneIn(6)) return drawn(NARROW_TEXT_OPERATIONS<Both>, b.random);
    }
    return drawn(INLINE_TEXT_OPERATIONS<Both>, b.random);
}

} // namespace inline_text

#endif

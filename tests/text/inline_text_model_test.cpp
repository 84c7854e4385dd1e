// Random operations on BufStr<15>, BufStr<255> and WBStr, each beside its model.

#include "tests/support/random_steps.h"
#include "tests/text/string_kinds.h"
#include "tests/text/text_model.h"

#include <gtest/gtest.h>

#include <array>
#include <cctype>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

using namespace ZOR_Basis;

namespace {

template <class String>
class Walk {
    using Char = typename Kind<String>::Char;
    using View = typename Kind<String>::View;
    using Text = std::basic_string<Char>;
    using Source = ModelSource<Char>;
    static constexpr std::uint64_t N = Kind<String>::Inside;
    static constexpr bool Narrow = sizeof(Char) == 1;

public:
    Walk() : random_(randomSource()) { restart(); }

    /// One step; empty text where string and model agree afterwards.
    std::string step() {
        std::string const name = operate();
        return agree() ? std::string() : name;
    }

private:
    std::uint64_t below(std::uint64_t bound) { return random_() % bound; }
    bool oneIn(std::uint64_t chances) { return below(chances) == 0; }

    Char unit() {
        if (oneIn(12)) return Char('z');
        if (oneIn(40)) return Char();
        if (oneIn(20)) return static_cast<Char>(0x80 + below(0x80));
        return static_cast<Char>('a' + below(26));
    }
    /// Mostly short, often around the size of the area.
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

    /// A source as the string gets it and as the model sees it: text of its own block, null, or part of the string's
    /// text.
    struct Given {
        Char const* pointer;
        Source model;
        std::unique_ptr<Char[]> block;
    };
    Given source() {
        if (oneIn(30)) return {nullptr, {{}, below(5)}, nullptr};
        std::uint64_t const given = oneIn(2) ? 0 : length();
        if (oneIn(5)) {
            std::uint64_t const from = below(model_->content.size() + 1);
            return {static_cast<Char const*>(*string_) + from, {model_->content.substr(from), given}, nullptr};
        }
        Text const units = text();
        // Exactly as long as it must be, so that a sanitizer sees every read too far.
        std::uint64_t const size = std::min<std::uint64_t>(units.find(Char()), units.size()) + 1;
        auto block = std::make_unique<Char[]>(size);
        std::copy_n(units.c_str(), size, block.get());
        Char const* pointer = block.get();
        return {pointer, {units, given}, std::move(block)};
    }

    void restart() {
        switch (below(4)) {
        case 0: {
            string_.emplace();
            model_.emplace(N);
            break;
        }
        case 1: {
            Text const units = text();
            Source const s{units, 0};
            string_.emplace(units.c_str());
            model_.emplace(N);
            model_->assign(s);
            break;
        }
        case 2: {
            Text const units = text();
            std::uint64_t const given = length();
            string_.emplace(View(units.c_str(), given));
            model_.emplace(N);
            model_->assign({units, given});
            break;
        }
        default: {
            if (!string_) return restart();
            String const copy(*string_);
            Source const s{model_->content, model_->content.size()};
            string_.emplace(copy);
            model_.emplace(N);
            model_->assign(s);
            // the copy of a copy has zeros behind the first one, as the first copy has
            break;
        }
        }
    }

    std::string operate() {
        if (oneIn(40)) {
            restart();
            return "restart";
        }
        String& s = *string_;
        TextModel<Char>& m = *model_;
        std::uint64_t const size = m.content.size();
        std::uint64_t const place = oneIn(8) ? size + below(3) : below(size + 1);
        switch (below(Narrow ? 24 : 20)) {
        case 0: {
            Given const g = source();
            s.copy(g.pointer, g.model.length);
            m.assign(g.model);
            return "copy";
        }
        case 1: {
            Given const g = source();
            if (g.pointer == static_cast<Char const*>(s)) return "";
            s = g.pointer;
            m.assign({g.model.units, 0});
            return "assign text";
        }
        case 2: {
            Given const g = source();
            s = View(g.pointer, g.model.length);
            m.assign(g.model);
            return "assign view";
        }
        case 3: {
            Text const units = text();
            String const other(units.c_str(), units.size());
            TextModel<Char> otherModel(N);
            otherModel.assign({units, units.size()});
            s = other;
            m.assign({otherModel.content, otherModel.content.size()});
            return "assign string";
        }
        case 4:
        case 5: {
            Given const g = source();
            s.add(g.pointer, g.model.length);
            m.append(g.model);
            return "add text";
        }
        case 6: {
            Given const g = source();
            s += View(g.pointer, g.model.length);
            m.append(g.model);
            return "add view";
        }
        case 7: {
            s.add(s);
            m.append({Text(m.content), m.content.size()});
            return "add itself";
        }
        case 8:
        case 9: {
            Char const c = unit();
            s += c;
            m.append(c);
            return "add unit";
        }
        case 10: {
            Given const g = source();
            s.insert(place, g.pointer, g.model.length);
            m.insert(place, g.model);
            return "insert";
        }
        case 11: {
            Given const g = source();
            std::uint64_t const count = oneIn(10) ? ~std::uint64_t{0} : below(size + 3);
            s.replace(place, count, g.pointer, g.model.length);
            m.replace(place, count, g.model);
            return "replace";
        }
        case 12: {
            s.cut(place);
            m.cut(place);
            return "cut to";
        }
        case 13: {
            s.cut();
            if (size > 0) m.cut(size - 1);
            return "cut";
        }
        case 14: {
            s.clear();
            m.content.clear();
            return "clear";
        }
        case 15: {
            std::uint64_t const n = length();
            s.extendBuf(n);
            m.extend(n);
            return "extend";
        }
        case 16: {
            Text units = text();
            if (oneIn(4)) units.resize(m.capacity + 1, Char('w'));
            if (units.size() > m.capacity + 1) units.resize(m.capacity + 1);
            std::copy(units.begin(), units.end(), s.getBuf());
            if (units.size() <= m.capacity) s.getBuf()[units.size()] = Char();
            std::uint64_t const n = oneIn(2) ? 0 : length();
            s.resize(n);
            m.written(units, n);
            return "write and resize";
        }
        case 17: {
            if (size == 0) return "";
            std::uint64_t const i = below(size);
            Char const c = oneIn(4) ? Char() : unit();
            s[i] = c;
            m.content[i] = c;
            return "write one";
        }
        case 18: {
            s.NextLatin();
            m.nextLatin();
            return "count on";
        }
        case 19: {
            String const& same = s;
            s = same;
            s = static_cast<View const&>(same);
            s = static_cast<Char const*>(same);
            return "assign itself";
        }
        default:
            if constexpr (Narrow) return operateNarrow(s, m, place);
            return "";
        }
    }

    std::string operateNarrow(String& s, TextModel<Char>& m, std::uint64_t place) {
        switch (below(5)) {
        case 0: {
            Given const g = source();
            s.replaceTail(place, g.pointer, g.model.length);
            m.replaceTail(place, g.model);
            return "replace tail";
        }
        case 1: {
            int const number = static_cast<int>(random_());
            s << number;
            m.append({std::to_string(number), 0});
            return "number";
        }
        case 2: {
            s.toUpper();
            for (char& c : m.content) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
            return "upper";
        }
        case 3: {
            Given const g = source();
            std::string digits;
            for (char c : Source{g.model.units, 0}.empty() ? "" : g.model.units) {
                if (c == '\0') break;
                digits += "0123456789abcdef"[static_cast<unsigned char>(c) / 16];
                digits += "0123456789abcdef"[static_cast<unsigned char>(c) % 16];
            }
            if (g.pointer == nullptr) digits.clear();
            s.toHex(g.pointer);
            m.content.clear();
            for (char digit : digits) m.append(digit);
            return "to hex";
        }
        default: {
            Given const g = source();
            std::string digits = g.model.units.substr(0, g.model.units.find('\0'));
            s.fromHex(g.pointer);
            for (std::size_t i = 0; i + 1 < digits.size(); i += 2) {
                auto const digit = [](char c) {
                    auto const at = std::string_view("0123456789abcdefABCDEF").find(c);
                    return at == std::string_view::npos ? 255U : static_cast<unsigned>(at > 15 ? at - 6 : at);
                };
                m.append(static_cast<char>(static_cast<unsigned char>(16 * digit(digits[i]) + digit(digits[i + 1]))));
            }
            return "from hex";
        }
        }
    }

    bool agree() const {
        String const& s = *string_;
        Char const* held = s;
        return s.size() == model_->content.size() && held[s.size()] == Char() &&
               std::char_traits<Char>::compare(held, model_->content.data(), s.size()) == 0 &&
               s.sizeBuf() == model_->capacity && isInside(s) == !model_->onHeap;
    }

    std::mt19937_64 random_;
    std::optional<String> string_;
    std::optional<TextModel<Char>> model_;
};

template <class String>
class InlineStringModel : public testing::Test {};

} // namespace

using Kinds = testing::Types<BufStr<15>, BufStr<255>, WBStr>;
TYPED_TEST_SUITE(InlineStringModel, Kinds, );

TYPED_TEST(InlineStringModel, agrees_after_every_random_operation) {
    Walk<TypeParam> walk;
    std::uint64_t const steps = randomSteps(1'000'000);
    for (std::uint64_t step = 0; step < steps; ++step) {
        std::string const difference = walk.step();
        ASSERT_EQ(difference, "") << "at step " << step;
    }
}

// Random operations on HeapStr beside a standard string and a capacity.

#include "tests/support/random_steps.h"
#include "tests/text/text_model.h"
#include "zor_basis/text/heap_str.h"

#include <gtest/gtest.h>

#include <cctype>
#include <cstring>
#include <optional>

using namespace ZOR_Basis;

namespace {

class Open : public HeapStr {
public:
    using HeapStr::HeapStr;
    using HeapStr::operator=;
    std::uint64_t capacity() const { return capacity_; }
};

struct Model {
    std::string content;
    std::uint64_t capacity = 0;

    void set(std::string const& units, std::uint64_t n) {
        content = TextModel<char>::stopAndPad(units, n);
        capacity = n;
    }
    bool agrees(Open const& s) const {
        bool const shared = s.c_str() == Str::StrEmpty;
        return s.size() == content.size() && std::memcmp(s.c_str(), content.c_str(), content.size() + 1) == 0 &&
               s.capacity() == capacity && shared == (capacity == 0);
    }
};

class Walk {
public:
    Walk() : random_(randomSource()) { string_.emplace(); }

    std::string step() {
        std::string const name = operate(*string_);
        return model_.agrees(*string_) ? std::string() : name;
    }

private:
    std::uint64_t below(std::uint64_t bound) { return random_() % bound; }
    bool oneIn(std::uint64_t chances) { return below(chances) == 0; }
    std::string text() {
        std::string result(oneIn(10) ? below(300) : below(12), '\0');
        for (char& c : result) c = oneIn(30) ? '\0' : static_cast<char>('A' + below(60));
        return result;
    }
    static std::uint64_t measured(std::string const& units) { return std::strlen(units.c_str()); }

    std::string operate(Open& s) {
        std::string const units = text();
        std::uint64_t const n = oneIn(3) ? units.size() + below(4) : below(units.size() + 1);
        std::uint64_t const from = below(model_.content.size() + 1);
        std::string const own = model_.content.substr(from);
        switch (below(14)) {
        case 0:
            s.set(units.c_str());
            model_.set(units, measured(units));
            return "set measured";
        case 1:
            s.set(units.c_str(), n);
            model_.set(units, n);
            return "set";
        case 2:
            s = Str(units.c_str(), n);
            model_.set(units, n);
            return "assign view";
        case 3:
            s = units;
            model_.set(units, units.size());
            return "assign standard string";
        case 4:
            s = units.c_str();
            model_.set(units, measured(units));
            return "assign text";
        case 5: {
            Open const other(units.c_str(), n);
            s = other;
            model_.set(TextModel<char>::stopAndPad(units, n), n);
            return "assign string";
        }
        case 6:
            s.set(s.c_str() + from);
            model_.set(own, measured(own));
            return "set its own tail";
        case 7:
            s.set(s.c_str() + from, n);
            model_.set(own, n);
            return "set a part of itself";
        case 8:
            s.cut();
            if (!model_.content.empty()) model_.content.pop_back();
            return "cut";
        case 9: {
            std::uint64_t const place = below(model_.content.size() + 3);
            s.cut(place);
            if (place < model_.content.size()) model_.content.resize(place);
            return "cut to";
        }
        case 10:
            s.toLower();
            for (char& c : model_.content) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
            return "lower";
        case 11:
            if (!oneIn(4)) return "";
            s.clear();
            model_ = {};
            return "clear";
        case 12: {
            Open const copy(s);
            string_.emplace(copy);
            model_.set(std::string(model_.content), model_.content.size());
            return "copy";
        }
        default:
            string_.emplace(units.c_str(), n);
            model_.set(units, n);
            return "make";
        }
    }

    std::mt19937_64 random_;
    std::optional<Open> string_;
    Model model_;
};

} // namespace

TEST(HeapStrModel, agrees_after_every_random_operation) {
    Walk walk;
    std::uint64_t const steps = randomSteps(1'000'000);
    for (std::uint64_t step = 0; step < steps; ++step) {
        std::string const difference = walk.step();
        ASSERT_EQ(difference, "") << "at step " << step;
    }
}

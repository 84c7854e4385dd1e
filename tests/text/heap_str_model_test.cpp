// Applies random operations to a HeapStr and to its model, a standard string with a capacity.

#include "tests/support/operations.h"
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

struct HeapStrModelled {
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

class HeapStrBesideModel {
public:
    HeapStrBesideModel() : random(randomSource()) { remake(); }

    std::uint64_t below(std::uint64_t bound) { return random() % bound; }
    bool oneIn(std::uint64_t chances) { return below(chances) == 0; }
    std::string text() {
        std::string result(oneIn(10) ? below(300) : below(12), '\0');
        for (char& c : result) c = oneIn(30) ? '\0' : static_cast<char>('A' + below(60));
        return result;
    }
    /// A length for a text, sometimes beyond its end.
    std::uint64_t lengthFor(std::string const& units) {
        return oneIn(3) ? units.size() + below(4) : below(units.size() + 1);
    }
    /// An index into the string's own text.
    std::uint64_t place() { return below(model.content.size() + 1); }

    template <class... Arguments>
    void remake(Arguments const&... arguments) {
        held_.emplace(arguments...);
    }
    Open& string() { return *held_; }
    bool agree() const { return model.agrees(*held_); }

    std::mt19937_64 random;
    HeapStrModelled model;

private:
    std::optional<Open> held_;
};

using Both = HeapStrBesideModel;

std::uint64_t measured(std::string const& units) { return std::strlen(units.c_str()); }

void setMeasured(Both& b) {
    std::string const units = b.text();
    b.string().set(units.c_str());
    b.model.set(units, measured(units));
}

void set(Both& b) {
    std::string const units = b.text();
    std::uint64_t const n = b.lengthFor(units);
    b.string().set(units.c_str(), n);
    b.model.set(units, n);
}

void assignView(Both& b) {
    std::string const units = b.text();
    std::uint64_t const n = b.lengthFor(units);
    b.string() = Str(units.c_str(), n);
    b.model.set(units, n);
}

void assignStandardString(Both& b) {
    std::string const units = b.text();
    b.string() = units;
    b.model.set(units, units.size());
}

void assignText(Both& b) {
    std::string const units = b.text();
    b.string() = units.c_str();
    b.model.set(units, measured(units));
}

void assignString(Both& b) {
    std::string const units = b.text();
    std::uint64_t const n = b.lengthFor(units);
    Open const other(units.c_str(), n);
    b.string() = other;
    b.model.set(TextModel<char>::stopAndPad(units, n), n);
}

void setItsTail(Both& b) {
    std::uint64_t const from = b.place();
    std::string const own = b.model.content.substr(from);
    b.string().set(b.string().c_str() + from);
    b.model.set(own, measured(own));
}

void setAPartOfItself(Both& b) {
    std::uint64_t const from = b.place();
    std::string const own = b.model.content.substr(from);
    std::uint64_t const n = b.lengthFor(own);
    b.string().set(b.string().c_str() + from, n);
    b.model.set(own, n);
}

void cut(Both& b) {
    b.string().cut();
    if (!b.model.content.empty()) b.model.content.pop_back();
}

void cutTo(Both& b) {
    std::uint64_t const place = b.below(b.model.content.size() + 3);
    b.string().cut(place);
    if (place < b.model.content.size()) b.model.content.resize(place);
}

void toLower(Both& b) {
    b.string().toLower();
    for (char& c : b.model.content) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
}

void clear(Both& b) {
    b.string().clear();
    b.model = {};
}

void copy(Both& b) {
    Open const copied(b.string());
    b.remake(copied);
    b.model.set(std::string(b.model.content), b.model.content.size());
}

void make(Both& b) {
    std::string const units = b.text();
    std::uint64_t const n = b.lengthFor(units);
    b.remake(units.c_str(), n);
    b.model.set(units, n);
}

constexpr Operation<Both> HEAP_STR_OPERATIONS[] = {
    {"set measured", 4, setMeasured},
    {"set", 4, set},
    {"assign a view", 4, assignView},
    {"assign a standard string", 4, assignStandardString},
    {"assign a text", 4, assignText},
    {"assign a string", 4, assignString},
    {"set its own tail", 4, setItsTail},
    {"set a part of itself", 4, setAPartOfItself},
    {"cut", 4, cut},
    {"cut to a place", 4, cutTo},
    {"lower", 4, toLower},
    {"clear", 1, clear},
    {"copy", 4, copy},
    {"make", 4, make},
};

} // namespace

TEST(HeapStrModel, agrees_after_every_random_operation) {
    Both b;
    std::uint64_t const steps = randomSteps(1'000'000);
    for (std::uint64_t step = 0; step < steps; ++step) {
        Operation<Both> const& operation = drawn(HEAP_STR_OPERATIONS, b.random);
        operation.act(b);
        ASSERT_TRUE(b.agree()) << operation.name << " at step " << step;
    }
}

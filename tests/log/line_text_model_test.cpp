// Compares lines of random formats and values with those of `snprintf`.

#include "tests/log/line_check.h"
#include "tests/support/operations.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <cstring>
#include <string>

namespace {

class RandomConversion {
public:
    explicit RandomConversion(std::mt19937_64& random) : random_(random) {}

    std::string text(char const* kinds, char const* length, bool hasPrecision) {
        std::string made = "%";
        char const flags[] = "-0+ ";
        for (std::uint64_t i = random_() % 8; i < 3; ++i) made += flags[random_() % 4];
        if (random_() % 3 == 0) made += std::to_string(1 + random_() % (random_() % 8 == 0 ? 60 : 14));
        if (hasPrecision && random_() % 4 != 0) made += "." + std::to_string(random_() % (random_() % 4 == 0 ? 26 : 8));
        made += length;
        return made + kinds[random_() % std::strlen(kinds)];
    }

private:
    std::mt19937_64& random_;
};

double randomDouble(std::mt19937_64& random) {
    std::uint64_t const bits = random();
    double number = 0;
    switch (random() % 6) {
    case 0: // any bits at all
        std::memcpy(&number, &bits, sizeof number);
        return number;
    case 1: // in the middle between two decimals, or next to it
        number = static_cast<double>(bits % 20001) / static_cast<double>(std::uint64_t{1} << (random() % 20));
        return random() % 2 == 0 ? number : std::nextafter(number, random() % 2 == 0 ? 0.0 : 1e300);
    case 2: // what people write
        return static_cast<double>(static_cast<std::int64_t>(bits % 2'000'000) - 1'000'000) /
               std::pow(10.0, static_cast<double>(random() % 9));
    case 3: // a decimal with a 5 at its end
        number = (static_cast<double>(bits % 100'000) * 10 + 5) / std::pow(10.0, static_cast<double>(1 + random() % 9));
        return random() % 2 == 0 ? number : -number;
    case 4: // whole numbers of all sizes
        return static_cast<double>(static_cast<std::int64_t>(bits >> (random() % 64)));
    default: // all sizes that are printed as decimals
        return std::ldexp(static_cast<double>(bits >> 11), static_cast<int>(random() % 160) - 150);
    }
}

std::uint64_t randomInteger(std::mt19937_64& random) {
    std::uint64_t const number = random() >> (random() % 64);
    return random() % 2 == 0 ? number : 0 - number;
}

std::string randomText(std::mt19937_64& random) {
    std::string text;
    std::uint64_t const size = random() % (random() % 50 == 0 ? 1100 : 30);
    while (text.size() < size) text += static_cast<char>('!' + random() % 90);
    return text;
}

/// Checks lines of one conversion and counts those that took the short way.
class RandomLines {
public:
    template <class Value>
    void check(char const* kinds, char const* length, bool hasPrecision, Value value) {
        std::string const format = "<" + conversion_.text(kinds, length, hasPrecision) + ">%%";
        quick += ::check(format.c_str(), value) ? 1 : 0;
    }
    template <class Value>
    void checkInteger(char const* length) {
        bool const precise = oneIn(8);
        check("diuxXo", length, precise, static_cast<Value>(randomInteger(random)));
    }
    bool oneIn(std::uint64_t chances) { return random() % chances == 0; }

    std::mt19937_64 random = randomSource();
    std::uint64_t quick = 0;

private:
    RandomConversion conversion_{random};
};

constexpr Operation<RandomLines> KINDS[] = {
    {"int", 1, [](RandomLines& lines) { lines.checkInteger<int>(""); }},
    {"short and char", 1, [](RandomLines& lines) { lines.checkInteger<int>(lines.oneIn(2) ? "h" : "hh"); }},
    {"long", 1, [](RandomLines& lines) { lines.checkInteger<long>("l"); }},
    {"long long", 1, [](RandomLines& lines) { lines.checkInteger<long long>("ll"); }},
    {"64 bits", 1,
     [](RandomLines& lines) {
         char const* const lengths[] = {"z", "j", "t"};
         lines.checkInteger<std::intmax_t>(lengths[lines.random() % 3]);
     }},
    {"text", 1, [](RandomLines& lines) { lines.check("s", "", true, randomText(lines.random).c_str()); }},
    {"character", 1,
     [](RandomLines& lines) { lines.check("c", "", false, static_cast<int>(1 + lines.random() % 255)); }},
    {"double of any kind", 1,
     [](RandomLines& lines) { lines.check("fFeEgG", lines.oneIn(4) ? "l" : "", true, randomDouble(lines.random)); }},
    {"fixed double", 2, [](RandomLines& lines) { lines.check("f", "", true, randomDouble(lines.random)); }},
};

} // namespace

TEST(LineTextModel, is_the_one_of_printf_for_random_single_conversions) {
    RandomLines lines;
    std::uint64_t const steps = randomSteps(400'000);
    for (std::uint64_t i = 0; i < steps; ++i) {
        Operation<RandomLines> const& kind = drawn(KINDS, lines.random);
        kind.act(lines);
        ASSERT_FALSE(testing::Test::HasFailure()) << kind.name << " at step " << i;
    }
    EXPECT_GT(lines.quick, steps / 3);
}

TEST(LineTextModel, is_the_one_of_printf_for_random_lines) {
    std::mt19937_64 random = randomSource();
    RandomConversion conversion(random);
    std::uint64_t const steps = randomSteps(200'000);
    for (std::uint64_t i = 0; i < steps && !testing::Test::HasFailure(); ++i) {
        std::string const text = randomText(random);
        std::string const format = randomText(random).substr(0, 3) + " " + conversion.text("s", "", true) + " " +
                                   conversion.text("d", "", false) + conversion.text("fffg", "", true) +
                                   conversion.text("ux", "ll", false) + "%%";
        if (format.substr(0, 3).find('%') != std::string::npos) continue;
        check(format.c_str(), text.c_str(), static_cast<int>(randomInteger(random)), randomDouble(random),
              static_cast<unsigned long long>(randomInteger(random)));
    }
}

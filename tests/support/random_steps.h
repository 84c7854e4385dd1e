/// \file
/// Length and seed of random tests. `ZB_TEST_STEPS_PERCENT` changes every length, `ZB_TEST_SEED` replaces the seed.

#ifndef TESTS_SUPPORT_RANDOM_STEPS_H
#define TESTS_SUPPORT_RANDOM_STEPS_H

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <random>

inline std::uint64_t numberFromEnvironment(char const* name, std::uint64_t fallback) {
    char const* text = std::getenv(name);
    return text != nullptr && *text != '\0' ? std::strtoull(text, nullptr, 10) : fallback;
}

inline std::uint64_t randomSteps(std::uint64_t ordinary) {
    return std::max<std::uint64_t>(ordinary * numberFromEnvironment("ZB_TEST_STEPS_PERCENT", 100) / 100, 1);
}

/// Of so many cases of an exhaustive test one is enough where tests are shortened.
inline std::uint64_t caseStride() {
    return std::max<std::uint64_t>(
        100 / std::max<std::uint64_t>(numberFromEnvironment("ZB_TEST_STEPS_PERCENT", 100), 1), 1);
}

inline std::mt19937_64 randomSource() { return std::mt19937_64{numberFromEnvironment("ZB_TEST_SEED", 20'211)}; }

#endif

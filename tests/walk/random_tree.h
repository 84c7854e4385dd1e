/// \file
/// A tree of random folders and files of random bytes.

#ifndef TESTS_WALK_RANDOM_TREE_H
#define TESTS_WALK_RANDOM_TREE_H

#include "tests/support/scratch.h"

#include <random>
#include <string>

inline std::string randomBytes(std::mt19937_64& random) {
    std::string bytes(random() % 5 == 0 ? random() % 200'000 : random() % 300, '\0');
    for (char& byte : bytes) byte = static_cast<char>(random());
    return bytes;
}

inline void fillRandomly(std::string const& folder, unsigned depth, std::mt19937_64& random) {
    for (int i = 0; i < 8; ++i) {
        std::string const path = folder + "/some name " + std::to_string(i);
        if (depth != 0 && random() % 3 == 0) {
            makeFolder(path);
            fillRandomly(path, depth - 1, random);
        } else {
            put(path, randomBytes(random));
        }
    }
}

#endif

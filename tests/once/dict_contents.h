/// \file
/// The two contents that a child saves. Each takes several pieces of a file.

#ifndef TESTS_ONCE_DICT_CONTENTS_H
#define TESTS_ONCE_DICT_CONTENTS_H

#include "tests/store/dict_files.h"

inline Pairs twoContents(int n) {
    Pairs pairs;
    for (int i = 0; i < 40 + 20 * n; ++i) {
        pairs.emplace_back("key " + std::to_string(n) + std::to_string(i),
                           std::string(5'000 + static_cast<std::size_t>(i), static_cast<char>('a' + n)));
    }
    return pairs;
}

#endif

/// \file
/// The order of texts, byte by byte.

#ifndef TESTS_TEXT_NAIVE_ORDER_H
#define TESTS_TEXT_NAIVE_ORDER_H

/// \return -1, 0 or 1
inline int signOf(int order) { return (order > 0) - (order < 0); }

/// The order of two terminated texts.
inline int naiveOrder(char const* a, char const* b) {
    for (;; ++a, ++b) {
        int const left = static_cast<unsigned char>(*a);
        int const right = static_cast<unsigned char>(*b);
        if (left != right) return left < right ? -1 : 1;
        if (left == 0) return 0;
    }
}

#endif

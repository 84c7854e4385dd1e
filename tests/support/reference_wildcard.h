/// \file
/// The rule of wildcards as documented, by trying all possibilities.

#ifndef TESTS_SUPPORT_REFERENCE_WILDCARD_H
#define TESTS_SUPPORT_REFERENCE_WILDCARD_H

inline bool isAnySlash(char c) { return c == '/' || c == '\\'; }

/// \tparam Case  folds the characters to compare
template <class Case>
bool literally(char const* pattern, char const* name) {
    while (*name != '\0') {
        if (isAnySlash(*pattern) && isAnySlash(*name)) {
            while (isAnySlash(*pattern)) ++pattern;
            while (isAnySlash(*name)) ++name;
        } else if (*pattern == '?' || Case::fold(*pattern) == Case::fold(*name)) {
            ++pattern;
            ++name;
        } else if (*pattern != '*') {
            return false;
        } else if (pattern[1] == '\0') {
            return true;
        } else {
            for (; *name != '\0'; ++name) {
                if (literally<Case>(pattern + 1, name)) return true;
            }
            return false;
        }
    }
    while (*pattern == '*') ++pattern;
    return *pattern == '\0';
}

#endif

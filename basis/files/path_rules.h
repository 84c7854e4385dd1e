/// \file
/// The grammar of paths, as plain functions over the character type that touch no system. Narrow and wide paths are
/// made of them. Texts are zero-terminated and not null; where a length is given it is exact.

#ifndef BASIS_FILES_PATH_RULES_H
#define BASIS_FILES_PATH_RULES_H

#include "zor_basis/text/char_ops.h"

#include <cctype>
#include <cstdint>
#include <cwctype>

namespace ZOR_Basis::PathRules {

using detail::isNothing;

template <class Char>
inline constexpr Char EMPTY[] = {0};

/// The path that is passed on: a null path becomes the empty one.
template <class Char>
constexpr Char const* orEmpty(Char const* path) {
    return path != nullptr ? path : EMPTY<Char>;
}

template <class Char>
constexpr bool isSlash(Char c) {
    return c == Char('/') || c == Char('\\');
}

inline char upper(char c) { return static_cast<char>(std::toupper(static_cast<unsigned char>(c))); }
inline WChar upper(WChar c) { return static_cast<WChar>(std::towupper(static_cast<std::wint_t>(c))); }

/// "C:/": any character, a colon, a slash.
template <class Char>
bool isDos(Char const* text) {
    return text[0] != Char() && text[1] == Char(':') && isSlash(text[2]);
}

template <class Char>
bool isAbsolute(Char const* text) {
    return isSlash(text[0]) || isDos(text);
}

template <class Char>
bool isURL(Char const* text) {
    while (*text != Char() && *text != Char(':')) ++text;
    return *text != Char() && isSlash(text[1]) && isSlash(text[2]) && text[3] != Char();
}

template <class Char>
bool isWildCard(Char const* text) {
    for (; *text != Char(); ++text) {
        if (*text == Char('*') || *text == Char('?')) return true;
    }
    return false;
}

/// The index behind the last slash among the first `length` characters; 0 if there is none.
template <class Char>
std::uint64_t offsetName(Char const* text, std::uint64_t length) {
    while (length > 0 && !isSlash(text[length - 1])) --length;
    return length;
}

template <class Char>
void replaceAll(Char* text, Char from, Char to) {
    for (; *text != Char(); ++text) {
        if (*text == from) *text = to;
    }
}

template <class Char>
Char const* skipSlashes(Char const* text) {
    while (isSlash(*text)) ++text;
    return text;
}

/// Whether `directory` is `path` or leads to it, whatever the case of the letters.
template <class Char>
bool isSub(Char const* path, Char const* directory) {
    if (isNothing(directory)) return true;
    if (isNothing(path)) return false;
    while (*directory != Char()) {
        if (*path == Char()) return *skipSlashes(directory) == Char();
        if (isSlash(*directory)) {
            if (!isSlash(*path)) return false;
            directory = skipSlashes(directory);
            path = skipSlashes(path);
            if (*directory == Char()) return true;
            if (*path == Char()) return false;
        } else {
            if (upper(*directory++) != upper(*path++)) return false;
        }
    }
    return *path == Char() || isSlash(*path);
}

/// Writes the normalised form: each run of slashes as one "/", the first run as two where it begins the text with two,
/// or, for a URL, wherever it stands.
/// \param out  room for the source's length + 1
/// \return the characters written
template <class Char>
std::uint64_t normalize(Char const* source, bool url, Char* out) {
    Char* const begin = out;
    // kept path-03: in a URL the first run counts as the one behind the scheme, whatever precedes it.
    bool firstRunPending = url || isSlash(*source);
    while (*source != Char()) {
        if (!isSlash(*source)) {
            *out++ = *source++;
            continue;
        }
        *out++ = Char('/');
        ++source;
        if (firstRunPending) {
            if (isSlash(*source) || url) *out++ = Char('/');
            firstRunPending = false;
        }
        source = skipSlashes(source);
    }
    return static_cast<std::uint64_t>(out - begin);
}

/// The first components that stand for the root folder.
inline constexpr std::uint64_t FAKE_ROOTS = 2;
template <class Char>
inline constexpr Char FAKE_ROOT[FAKE_ROOTS][8] = {
    {'s', 'c', 's', 'i', '0', 0},
    {'J', 'S', '_', 'R', 'o', 'o', 't', 0},
};
inline constexpr std::uint64_t FAKE_ROOT_LENGTH[FAKE_ROOTS] = {5, 7};

} // namespace ZOR_Basis::PathRules

#endif

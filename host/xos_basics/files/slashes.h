/// \file
/// The slash rule: both kinds separate, on every system.

#ifndef HOST_XOS_BASICS_FILES_SLASHES_H
#define HOST_XOS_BASICS_FILES_SLASHES_H

#include <algorithm>
#include <string>

namespace host {

template <class Char>
constexpr bool isSlash(Char character) {
    return character == Char('/') || character == Char('\\');
}

/// Turns every slash into the system's own kind.
template <class Char>
void unifySlashes(std::basic_string<Char>& path, Char own) {
    std::replace_if(path.begin(), path.end(), isSlash<Char>, own);
}

/// Cuts the slashes at the end; a path of slashes alone keeps one.
template <class Char>
void cutEndSlashes(std::basic_string<Char>& path) {
    while (path.size() > 1 && isSlash(path.back())) { path.pop_back(); }
}

/// Whether a name leads to the directory itself or out of it, so that it does not name an entry.
template <class Char>
bool isDots(Char const* name) {
    return name[0] == Char('.') && (name[1] == 0 || (name[1] == Char('.') && name[2] == 0));
}

} // namespace host

#endif

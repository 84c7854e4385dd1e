// The sibling is entry_names_posix.cpp.

#include "tools/zbtool/entry_names.h"

#include <windows.h>

namespace zbtool {

std::string withoutEndSlashes(std::string path) {
    auto const isSlash = [](char c) { return c == '/' || c == '\\'; };
    while (path.size() > 1 && isSlash(path.back()) && path[path.size() - 2] != ':') path.pop_back();
    return path;
}

std::string_view whyUnreachable(std::string_view) { return ""; }

std::string comparedName(std::string name) {
    // The system drops dots and blanks at the end of a name.
    name.erase(name.find_last_not_of(". ") + 1);
    CharUpperBuffA(name.data(), static_cast<DWORD>(name.size()));
    return name;
}

} // namespace zbtool

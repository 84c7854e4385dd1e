// The sibling is entry_names_win.cpp.

#include "tools/zbtool/entry_names.h"

namespace zbtool {

std::string withoutEndSlashes(std::string path) {
    while (path.size() > 1 && path.back() == '/') path.pop_back();
    return path;
}

// The library would reach the entry "b" of a folder "a" instead of an entry "a\b".
std::string_view whyUnreachable(std::string_view path) {
    return path.find('\\') == std::string_view::npos ? "" : "contains a backslash, which the library takes for a slash";
}

std::string comparedName(std::string name) { return name; }

} // namespace zbtool
